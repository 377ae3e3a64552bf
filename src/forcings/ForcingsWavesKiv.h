#pragma once

#include "setupeditor/ZoSEKivBase.h"

#include <vector>

class CMTWaveFieldKiv;
class CForcingsWaveDBListKiv;

// WAVES: where the wave forcing comes from, and the settings that hold for every source.
class CForcingsWavesKiv : public CZoSEKivBase {
public:
    enum WaveType { kNoWaves = 0, kWaveField = 1, kWaveDatabase = 2, kSpectralWaveField = 3 };

    explicit CForcingsWavesKiv(CZoSEKivBase* parent);
    ~CForcingsWavesKiv() override;

    int WaveType() const { return m_type; }
    void WaveType(int type) { m_type = type; }
    double MinimumWaterDepth() const { return m_minimumDepth; }
    void MinimumWaterDepth(double depth) { m_minimumDepth = depth; }
    bool IncludeLiquefaction() const { return m_includeLiquefaction; }
    void IncludeLiquefaction(bool include) { m_includeLiquefaction = include; }
    double LiquefactionFactor() const { return m_liquefactionFactor; }
    void LiquefactionFactor(double factor) { m_liquefactionFactor = factor; }
    int ShearStressFormulation() const { return m_shearStress; }
    void ShearStressFormulation(int formulation) { m_shearStress = formulation; }

    CMTWaveFieldKiv* WaveField() const { return m_waveField; }
    CForcingsWaveDBListKiv* WaveDatabase() const { return m_waveDatabase; }

    // The wave database needs the flow model's wind forcing, included and varying in time.
    bool IsWaveDatabaseAvailable() const;
    // The wave field of a spectral-wave simulation needs that simulation run alongside.
    bool IsSpectralWaveFieldAvailable() const;
    // The types a user may choose here, in list order.
    std::vector<int> AvailableWaveTypes() const;

    static CString WaveTypeText(int type);               // empty for an unknown type
    static const std::vector<CString>& ShearStressTexts();  // by formulation

    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    void ReadData(void* h) override;
    // Never fails. A database type that the wind forcing no longer allows becomes "No waves",
    // so that the engine never reads it; the message list says so.
    int ValidateData() override;
    bool IsDlgUsedInSetup() override { return true; }
    void SetDefault() override;
    const char* GetDlgRuntimeClass(unsigned code) override;

private:
    friend struct WavesFields;
    int m_type = 0;
    double m_minimumDepth = 0.0;
    bool m_includeLiquefaction = false;
    double m_liquefactionFactor = 1.0;
    int m_shearStress = 3;
    CMTWaveFieldKiv* m_waveField = nullptr;
    CForcingsWaveDBListKiv* m_waveDatabase = nullptr;
};

// The waves section of a setup ("MT Waves"); null where there is none.
CForcingsWavesKiv* WavesSection(const CZoSEKivBase* node);
