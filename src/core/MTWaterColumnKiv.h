#pragma once

#include "MTGroupKiv.h"

// WATER_COLUMN: sand fractions, settling, deposition, density and viscosity.
class CMTWaterColumnKiv : public CMTGroupKiv {
public:
    explicit CMTWaterColumnKiv(CZoSEKivBase* parent);
};
