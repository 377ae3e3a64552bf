#pragma once

#include "MTDredgingItemsKiv.h"
#include "widgets/ZoSEGridWndBase.h"

class CMTDredgingKiv;

// The dredgers, one a row: number, name, whether included, and a link to the dredger's page.
// A dredger that is not included shows its name and link greyed.
class CMTDredgingGrid : public CFemGridEditWnd<CMTDredgingItemsKiv> {
public:
    using CFemGridEditWnd::CFemGridEditWnd;
    void Initialize(CZoSEDlgBase* dialog, CMTDredgingKiv* list);
    // Rows follow the list; columns fitted again.
    void Refresh();

    void GetStyleRowCol(int row, int col, CGridCellStyle& style) override;

protected:
    void GetItemStyle(CMTDredgingItemsKiv* item, int row, int col, CGridCellStyle& style) override;
    int StoreItem(CMTDredgingItemsKiv* item, int row, int col, const CGridCellValue& value) override;
};
