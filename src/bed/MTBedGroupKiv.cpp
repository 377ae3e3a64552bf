#include "MTBedGroupKiv.h"

CMTBedGroupKiv::CMTBedGroupKiv(CZoSEKivBase* parent)
    : CMTGroupKiv("Bed Parameters", "BED", parent, 5011, "CMTGroupDlg") {
    // Children in file order; each section joins here.
}
