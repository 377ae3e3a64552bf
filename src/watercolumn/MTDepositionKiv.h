// DEPOSITION: the near-bed concentration profile and, per fraction, the critical shear
// stress for deposition.
#pragma once

#include "core/MTCountListKiv.h"
#include "fem/FemInDataKiv.h"

class CMTDepositionItemKiv : public CZoSEKivBase {
public:
    explicit CMTDepositionItemKiv(CZoSEKivBase* parent);

    CFemInDataKiv* CriticalShearStress() const { return m_criticalShearStress; }

    int ValidateData() override { return 1; }
    // Sand fractions deposit too.
    bool IsDlgUsedInSetup() override { return true; }
    const char* GetDlgRuntimeClass(unsigned code) override;
    void SetDefault() override { m_criticalShearStress->SetDefault(); }

private:
    CFemInDataKiv* m_criticalShearStress;
};

class CMTDepositionKiv : public CMTCountListKiv<CMTDepositionItemKiv> {
public:
    explicit CMTDepositionKiv(CZoSEKivBase* parent);

    // 0 Rouse profile; 1 Teeter profile.
    int ConcentrationProfile() const { return m_concentrationProfile; }
    void ConcentrationProfile(int v) { m_concentrationProfile = v; }
    // Relative height of the centroid, used with the Rouse profile.
    double CentroidHeight() const { return m_centroidHeight; }
    void CentroidHeight(double v) { m_centroidHeight = v; }

    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    void ReadData(void* h) override;
    int ValidateData() override { return 1; }
    bool IsDlgUsedInSetup() override { return true; }
    const char* GetDlgRuntimeClass(unsigned code) override;
    void SetDefault() override;

private:
    friend struct DepositionFields;
    int m_concentrationProfile = 0;
    double m_centroidHeight = 0.0;
};
