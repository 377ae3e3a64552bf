// DENSITY_AND_VISCOSITY: feedback of the suspended mud on the flow's density, and the
// constants of the viscosity formula.
#pragma once

#include "setupeditor/ZoSEKivBase.h"

class CMTDensityFeedbackKiv : public CZoSEKivBase {
public:
    explicit CMTDensityFeedbackKiv(CZoSEKivBase* parent);

    bool IncludeDensityFeedback() const { return m_includeFeedback; }
    void IncludeDensityFeedback(bool v) { m_includeFeedback = v; }
    double DensityOfSediment() const { return m_densityOfSediment; }
    void DensityOfSediment(double v) { m_densityOfSediment = v; }
    double BaseInViscosityFormula() const { return m_baseInViscosity; }
    void BaseInViscosityFormula(double v) { m_baseInViscosity = v; }
    double ConcentrationInViscosityFormula() const { return m_concentrationInViscosity; }
    void ConcentrationInViscosityFormula(double v) { m_concentrationInViscosity = v; }

    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    void ReadData(void* h) override;
    int ValidateData() override { return 1; }
    // Offered only where the flow's density varies ("HDDensity" mode above 0).
    bool IsDlgUsedInSetup() override;
    const char* GetDlgRuntimeClass(unsigned code) override;
    void SetDefault() override;

private:
    friend struct DensityFeedbackFields;
    bool m_includeFeedback = false;
    double m_densityOfSediment = 0.0;
    double m_baseInViscosity = 0.0;
    double m_concentrationInViscosity = 0.0;
};
