// SETTLING_VELOCITY: how fast the mud fractions sink, globally and per fraction.
#pragma once

#include "core/MTCountListKiv.h"
#include "fem/FemInDataKiv.h"

class CMTSettlingKiv;

class CMTSettlingItemKiv : public CZoSEKivBase {
public:
    explicit CMTSettlingItemKiv(CZoSEKivBase* parent);

    // Used without flocculation.
    CFemInDataKiv* ConstantSettlingVelocity() const { return m_constantVelocity; }
    // Used with flocculation.
    CFemInDataKiv* SettlingVelocityCoefficient() const { return m_coefficient; }
    double Gamma() const { return m_gamma; }
    void Gamma(double v) { m_gamma = v; }
    double Wsn() const { return m_wsn; }
    void Wsn(double v) { m_wsn = v; }

    // Only the value that the section's flocculation choice needs is in use.
    void UpdateValuesInUse();

    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    void ReadData(void* h) override;
    int ValidateData() override;
    // Sand fractions take no mud settling parameters.
    bool IsDlgUsedInSetup() override;
    const char* GetDlgRuntimeClass(unsigned code) override;
    void SetDefault() override;

private:
    friend struct SettlingItemFields;
    CMTSettlingKiv* Section() const;

    CFemInDataKiv* m_constantVelocity;
    CFemInDataKiv* m_coefficient;
    double m_gamma = 0.0;
    double m_wsn = 0.0;
};

class CMTSettlingKiv : public CMTCountListKiv<CMTSettlingItemKiv> {
public:
    explicit CMTSettlingKiv(CZoSEKivBase* parent);

    // 0 constant settling velocity; 1 flocculation included.
    int Flocculation() const { return m_flocculation; }
    void Flocculation(int v) { m_flocculation = v; }
    // 0 none; 1 Winterwerp; 2 Richardson and Zaki.
    int HinderedSettling() const { return m_hinderedSettling; }
    void HinderedSettling(int v) { m_hinderedSettling = v; }
    double RhoSediment() const { return m_rhoSediment; }
    void RhoSediment(double v) { m_rhoSediment = v; }
    double Cgel() const { return m_cgel; }
    void Cgel(double v) { m_cgel = v; }
    double Cfloc() const { return m_cfloc; }
    void Cfloc(double v) { m_cfloc = v; }
    double Chinder() const { return m_chinder; }
    void Chinder(double v) { m_chinder = v; }
    double C1Salt() const { return m_c1Salt; }
    void C1Salt(double v) { m_c1Salt = v; }
    double C2Salt() const { return m_c2Salt; }
    void C2Salt(double v) { m_c2Salt = v; }

    // The items in use (sand fractions skipped), in list order: the rows of the grids.
    int ItemInUseCount();
    CMTSettlingItemKiv* GetItemInUse(int row);  // 1-based, null outside

    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    void ReadData(void* h) override;
    int ValidateData() override { return 1; }
    bool IsDlgUsedInSetup() override;
    const char* GetDlgRuntimeClass(unsigned code) override;
    void SetDefault() override;

private:
    friend struct SettlingFields;
    int m_flocculation = 0;
    int m_hinderedSettling = 0;
    double m_rhoSediment = 0.0;
    double m_cgel = 0.0;
    double m_cfloc = 0.0;
    double m_chinder = 0.0;
    double m_c1Salt = 0.0;
    double m_c2Salt = 0.0;
};
