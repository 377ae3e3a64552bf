#pragma once

#include "fem/FemInDataKiv.h"
#include "setupeditor/ZoSEKivListBase.h"

// LAYER_%d of EROSION: the erosion law of one bed layer.
class CMTErosionItemKiv : public CZoSEKivBase {
public:
    explicit CMTErosionItemKiv(CZoSEKivListBaseInterface* list);

    // The layer this item was created for; its defaults depend on it.
    int LayerNumber() const { return m_layer; }

    bool SoftMud() const { return m_softMud; }
    // Changing the mud type resets the power of erosion to that type's value.
    void SoftMud(bool soft);
    double PowerOfErosion() const { return m_power->Constant(); }
    void PowerOfErosion(double power) { m_power->Constant(power); }
    // "Soft mud" or "Hard mud".
    CString DescriptionText() const;

    CFemInDataKiv* ErosionCoefficient() const { return m_coefficient; }
    CFemInDataKiv* CriticalShearStress() const { return m_shearStress; }
    CFemInDataKiv* PowerOfErosionValue() const { return m_power; }

    void WriteData(void* h) override;
    void DescribeKeywords(KeywordSink& sink) override;
    // Sets the mud type only: a power of erosion stored in the file stays in force.
    void ReadData(void* h) override;
    int ValidateData() override { return 1; }
    void SetDefault() override;
    const char* GetDlgRuntimeClass(unsigned code) override;

    static constexpr double kSoftMudPower = 8.3;
    static constexpr double kHardMudPower = 1.0;

private:
    friend struct ErosionItemFields;
    int m_layer;
    bool m_softMud = false;
    CFemInDataKiv* m_coefficient;
    CFemInDataKiv* m_shearStress;
    CFemInDataKiv* m_power;
};
