#pragma once

#include "MTGroupKiv.h"

// FORCINGS: waves.
class CMTForcingsGroupKiv : public CMTGroupKiv {
public:
    explicit CMTForcingsGroupKiv(CZoSEKivBase* parent);
};
