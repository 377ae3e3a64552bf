// DISPERSION: per fraction and per direction, how the fraction is dispersed.
#pragma once

#include "core/MTCountListKiv.h"
#include "core/MTGroupKiv.h"
#include "fem/FemInDataKiv.h"

#include <memory>

class CMTDispersionItemKiv : public CZoSEKivBase {
public:
    enum Formulation { kNoDispersion = 0, kDispersionCoefficient = 1, kScaledEddyViscosity = 2 };

    explicit CMTDispersionItemKiv(CZoSEKivBase* parent);
    ~CMTDispersionItemKiv() override;

    int FormulationType() const { return m_type; }
    void FormulationType(int type) { m_type = type; }
    CString FormulationText() const { return FormulationText(m_type); }
    // The text of a formulation type; empty for unknown types.
    static CString FormulationText(int type);

    // Owned by the item, not child nodes: the item reads, writes and checks them itself.
    // The scaled eddy viscosity may vary over the vertical only in a three-dimensional model.
    CFemInDataKiv* ScaledEddyViscosity();
    CFemInDataKiv* DispersionCoefficient() const { return m_coefficient.get(); }

    // Only the value of the chosen formulation is in use.
    void UpdateValuesInUse();

    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    void ReadData(void* h) override;
    int ValidateData() override;
    const char* GetDlgRuntimeClass(unsigned code) override;
    void SetDefault() override;

private:
    friend struct DispersionItemFields;
    void UpdateFormatCode();

    int m_type = kScaledEddyViscosity;
    std::unique_ptr<CFemInDataKiv> m_eddyViscosity;
    std::unique_ptr<CFemInDataKiv> m_coefficient;
};

class CMTDispersionListKiv : public CMTCountListKiv<CMTDispersionItemKiv> {
public:
    CMTDispersionListKiv(bool horizontal, const CString& title, const CString& sectionName,
                         CZoSEKivBase* parent);

    bool IsHorizontal() const { return m_horizontal; }

    int ValidateData() override { return 1; }
    // Vertical dispersion matters only in a three-dimensional model.
    bool IsDlgUsedInSetup() override;
    const char* GetDlgRuntimeClass(unsigned code) override;

private:
    bool m_horizontal;
};

class CMTDispersionKiv : public CMTGroupKiv {
public:
    explicit CMTDispersionKiv(CZoSEKivBase* parent);

    CMTDispersionListKiv* Horizontal() const { return m_horizontal; }
    CMTDispersionListKiv* Vertical() const { return m_vertical; }

private:
    CMTDispersionListKiv* m_horizontal;
    CMTDispersionListKiv* m_vertical;
};
