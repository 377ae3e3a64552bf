#pragma once

#include "setupeditor/ZoSEKivBase.h"

// MORPHOLOGY: whether the bed is updated morphologically, optionally sped up by a factor.
class CMTMorphologyKiv : public CZoSEKivBase {
public:
    explicit CMTMorphologyKiv(CZoSEKivBase* parent);

    bool IncludeMorphologicalUpdate() const { return m_includeUpdate; }
    void IncludeMorphologicalUpdate(bool include) { m_includeUpdate = include; }
    bool IncludeSpeedup() const { return m_includeSpeedup; }
    void IncludeSpeedup(bool include) { m_includeSpeedup = include; }
    double SpeedupFactor() const { return m_speedupFactor; }
    void SpeedupFactor(double factor) { m_speedupFactor = factor; }

    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    void ReadData(void* h) override;
    int ValidateData() override { return 1; }
    bool IsDlgUsedInSetup() override { return true; }
    void SetDefault() override;
    const char* GetDlgRuntimeClass(unsigned code) override;

private:
    friend struct MorphologyFields;
    bool m_includeUpdate = false;
    bool m_includeSpeedup = false;
    double m_speedupFactor = 0.0;
};
