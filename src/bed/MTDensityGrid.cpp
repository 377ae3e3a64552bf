#include "MTDensityGrid.h"

#include "MTDensityListKiv.h"

void CMTDensityGrid::Initialize(CZoSEDlgBase* dialog, CMTDensityListKiv* list) {
    CMTBedItemGrid::Initialize(dialog, list, {"Layer", "Format", "Edit"});
}

CString CMTDensityGrid::Description(CMTDensityItemKiv* item) const {
    return item->FormatText();
}
