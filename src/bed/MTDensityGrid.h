#pragma once

#include "MTBedItemGrid.h"
#include "MTDensityItemKiv.h"

class CMTDensityListKiv;

// Each layer with the kind of its density value.
class CMTDensityGrid : public CMTBedItemGrid<CMTDensityItemKiv> {
public:
    using CMTBedItemGrid::CMTBedItemGrid;
    void Initialize(CZoSEDlgBase* dialog, CMTDensityListKiv* list);

protected:
    CString Description(CMTDensityItemKiv* item) const override;
};
