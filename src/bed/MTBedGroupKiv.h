#pragma once

#include "core/MTGroupKiv.h"

class CMTErosionListKiv;
class CMTDensityListKiv;
class CMTBedRoughnessKiv;
class CMTTransitionListKiv;

// BED: erosion, bed density, roughness, transition (roughness before transition).
class CMTBedGroupKiv : public CMTGroupKiv {
public:
    explicit CMTBedGroupKiv(CZoSEKivBase* parent);

    CMTErosionListKiv* Erosion() const { return m_erosion; }
    CMTDensityListKiv* Density() const { return m_density; }
    CMTBedRoughnessKiv* Roughness() const { return m_roughness; }
    CMTTransitionListKiv* Transition() const { return m_transition; }

private:
    CMTErosionListKiv* m_erosion = nullptr;
    CMTDensityListKiv* m_density = nullptr;
    CMTBedRoughnessKiv* m_roughness = nullptr;
    CMTTransitionListKiv* m_transition = nullptr;
};
