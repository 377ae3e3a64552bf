#include "MTWaterColumnKiv.h"

CMTWaterColumnKiv::CMTWaterColumnKiv(CZoSEKivBase* parent)
    : CMTGroupKiv("Water Column Parameters", "WATER_COLUMN", parent, 5044, "CMTGroupDlg") {
    // Children in file order; each section joins here.
}
