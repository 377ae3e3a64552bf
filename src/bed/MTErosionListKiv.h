#pragma once

#include "MTErosionItemKiv.h"
#include "core/MTCountListKiv.h"

// EROSION: one erosion law per bed layer and the largest concentration erosion may produce.
class CMTErosionListKiv : public CMTCountListKiv<CMTErosionItemKiv> {
public:
    explicit CMTErosionListKiv(CZoSEKivBase* parent);

    double MaxConcentration() const { return m_maxConcentration; }
    void MaxConcentration(double value) { m_maxConcentration = value; }

    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    void ReadData(void* h) override;
    int ValidateData() override { return 1; }
    bool IsDlgUsedInSetup() override { return true; }
    void SetDefault() override;
    const char* GetDlgRuntimeClass(unsigned code) override;

private:
    friend struct ErosionListFields;
    double m_maxConcentration = 0.0;
};
