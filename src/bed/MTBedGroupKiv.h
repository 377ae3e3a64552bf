#pragma once

#include "core/MTGroupKiv.h"

// BED: erosion, bed density, roughness, transition (roughness before transition).
class CMTBedGroupKiv : public CMTGroupKiv {
public:
    explicit CMTBedGroupKiv(CZoSEKivBase* parent);
};
