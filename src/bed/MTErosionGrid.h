#pragma once

#include "MTBedItemGrid.h"
#include "MTErosionItemKiv.h"

class CMTErosionListKiv;

// Each layer with its mud type.
class CMTErosionGrid : public CMTBedItemGrid<CMTErosionItemKiv> {
public:
    using CMTBedItemGrid::CMTBedItemGrid;
    void Initialize(CZoSEDlgBase* dialog, CMTErosionListKiv* list);

protected:
    CString Description(CMTErosionItemKiv* item) const override;
};
