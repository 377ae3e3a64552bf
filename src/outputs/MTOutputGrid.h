// The outputs, one a row: name, include, a view of the result file and a link to the output.
#pragma once

#include "MTOutputItemMainKiv.h"
#include "widgets/ZoSEGridWndBase.h"

class CMTOutputKiv;

class CMTOutputGrid : public CFemGridEditWnd<CMTOutputItemMainKiv> {
public:
    using CFemGridEditWnd::CFemGridEditWnd;
    void Initialize(CZoSEDlgBase* dialog, CMTOutputKiv* list);

    void GetStyleRowCol(int row, int col, CGridCellStyle& style) override;
    void OnClickedButtonRowCol(int row, int col) override;
    // Whether "View..." opens the row's result file.
    bool CanView(CMTOutputItemMainKiv* output) const;

protected:
    void GetItemStyle(CMTOutputItemMainKiv* item, int row, int col, CGridCellStyle& style) override;
    int StoreItem(CMTOutputItemMainKiv* item, int row, int col, const CGridCellValue& value) override;
};
