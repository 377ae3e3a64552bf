#include "HDBoundaryConditionsKiv.h"

#include "fem/BoundaryNamesKiv.h"

namespace {
const char* const kKey = "BoundaryConditions";
}

CString CHDBoundaryConditionItemKiv::GetTitle() const {
    const CBoundaryNamesKiv* names = BoundaryNames(this);
    const CBoundaryNameKiv* boundary = names ? names->GetItem(GetNumberWhatAmI()) : nullptr;
    return boundary ? boundary->Identifier() : CString();
}

CHDBoundaryConditionsKiv::CHDBoundaryConditionsKiv(CZoSEKivBase* parent)
    : CZoSEKivListBase<CHDBoundaryConditionItemKiv>("Hydrodynamic Boundary Conditions", "",
                                                    parent) {
    GetRoot()->RegisterImportantNode(this, kKey);
    if (CBoundaryNamesKiv* names = BoundaryNames(this)) {
        SetItemCount(names->GetItemCount(), 1);
        names->RegisterSyncedList(this, 1);
    }
}

CHDBoundaryConditionsKiv::~CHDBoundaryConditionsKiv() {
    GetRoot()->UnregisterImportantNode(kKey);
    if (CBoundaryNamesKiv* names = BoundaryNames(this))
        names->UnRegisterSyncedList(this);
}
