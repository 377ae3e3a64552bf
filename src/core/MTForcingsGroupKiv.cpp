#include "MTForcingsGroupKiv.h"

#include "forcings/ForcingsWavesKiv.h"

CMTForcingsGroupKiv::CMTForcingsGroupKiv(CZoSEKivBase* parent)
    : CMTGroupKiv("Forcings", "FORCINGS", parent, 5028, "CMTGroupDlg") {
    AddChild(new CForcingsWavesKiv(this));
}
