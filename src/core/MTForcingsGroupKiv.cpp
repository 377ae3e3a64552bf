#include "MTForcingsGroupKiv.h"

CMTForcingsGroupKiv::CMTForcingsGroupKiv(CZoSEKivBase* parent)
    : CMTGroupKiv("Forcings", "FORCINGS", parent, 5028, "CMTGroupDlg") {
    // Children in file order; each section joins here.
}
