#pragma once

#include "setupeditor/ZoSEKivBase.h"

#include <vector>

// The hydrodynamic density mode ("HDDensity"): 0 barotropic; above 0 the density varies
// (with salinity, temperature or both).
class CHDDensityKiv : public CZoSEKivBase {
public:
    explicit CHDDensityKiv(CZoSEKivBase* parent);
    ~CHDDensityKiv() override;

    int DensityMode() const { return m_mode; }
    void DensityMode(int mode) { m_mode = mode; }
    // Display texts of the density modes, by value.
    static const std::vector<CString>& DensityModeTexts();

    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    void ReadData(void* h) override;
    int ValidateData() override;
    void SetDefault() override { m_mode = 0; }

private:
    int m_mode = 0;
};

CHDDensityKiv* HDDensity(const CZoSEKivBase* node);
