#pragma once

#include "setupeditor/ZoSEKivBase.h"

// The numerical schemes of the transport equations.
class CMTSolutionTechniqueKiv : public CZoSEKivBase {
public:
    explicit CMTSolutionTechniqueKiv(CZoSEKivBase* parent);

    int TimeIntegration() const { return m_timeIntegration; }
    void TimeIntegration(int v) { m_timeIntegration = v; }
    int SpaceHorizontal() const { return m_spaceHorizontal; }
    void SpaceHorizontal(int v) { m_spaceHorizontal = v; }
    int SpaceVertical() const { return m_spaceVertical; }
    void SpaceVertical(int v) { m_spaceVertical = v; }
    // The vertical scheme follows the horizontal one: 1 gives 1, 2 gives 3.
    void SyncVerticalScheme();

    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    void ReadData(void* h) override;
    int ValidateData() override { return 1; }
    bool IsDlgUsedInSetup() override { return true; }
    const char* GetDlgRuntimeClass(unsigned code) override;
    void SetDefault() override;

private:
    friend struct SolutionTechniqueFields;
    int m_timeIntegration = 0;
    int m_spaceHorizontal = 0;
    int m_spaceVertical = 0;
    int m_methodHorizontal = 0;
    int m_integrationMethod = 0;
    int m_updateFrequency = 0;
};
