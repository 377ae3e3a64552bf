#include "MTBedGroupKiv.h"

#include "MTBedRoughnessKiv.h"
#include "MTDensityListKiv.h"
#include "MTErosionListKiv.h"
#include "MTTransitionListKiv.h"

CMTBedGroupKiv::CMTBedGroupKiv(CZoSEKivBase* parent)
    : CMTGroupKiv("Bed Parameters", "BED", parent, 5011, "CMTGroupDlg") {
    // File order: roughness comes before transition.
    AddChild(m_erosion = new CMTErosionListKiv(this));
    AddChild(m_density = new CMTDensityListKiv(this));
    AddChild(m_roughness = new CMTBedRoughnessKiv(this));
    AddChild(m_transition = new CMTTransitionListKiv(this));
}
