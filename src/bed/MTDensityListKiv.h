#pragma once

#include "MTDensityItemKiv.h"
#include "core/MTCountListKiv.h"

// BED_DENSITY: one density per bed layer; no keyword of its own.
class CMTDensityListKiv : public CMTCountListKiv<CMTDensityItemKiv> {
public:
    explicit CMTDensityListKiv(CZoSEKivBase* parent)
        : CMTCountListKiv<CMTDensityItemKiv>("Density of Bed Layer", "BED_DENSITY", parent,
                                             MTCount::Layers) {}

    int ValidateData() override { return 1; }
    bool IsDlgUsedInSetup() override { return true; }
    const char* GetDlgRuntimeClass(unsigned code) override;
};
