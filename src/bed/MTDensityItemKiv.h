#pragma once

#include "fem/FemInDataKiv.h"
#include "setupeditor/ZoSEKivListBase.h"

// LAYER_%d of BED_DENSITY: the density of one bed layer.
class CMTDensityItemKiv : public CZoSEKivBase {
public:
    explicit CMTDensityItemKiv(CZoSEKivListBaseInterface* list);

    int LayerNumber() const { return m_layer; }
    // Its keywords go straight into the item's section.
    CFemInDataKiv* Density() const { return m_density; }
    // The grid's one-line description of the density.
    CString FormatText() const { return m_density->FormatText(); }

    int ValidateData() override { return 1; }
    void SetDefault() override { m_density->SetDefault(); }
    const char* GetDlgRuntimeClass(unsigned code) override;

    // Deeper layers are consolidated further.
    static double DefaultDensity(int layer);

private:
    int m_layer;
    CFemInDataKiv* m_density;
};
