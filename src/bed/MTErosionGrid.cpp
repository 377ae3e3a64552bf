#include "MTErosionGrid.h"

#include "MTErosionListKiv.h"

void CMTErosionGrid::Initialize(CZoSEDlgBase* dialog, CMTErosionListKiv* list) {
    CMTBedItemGrid::Initialize(dialog, list, {"Layer", "Mud type", ""});
}

CString CMTErosionGrid::Description(CMTErosionItemKiv* item) const {
    return item->DescriptionText();
}
