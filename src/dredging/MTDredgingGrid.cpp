#include "MTDredgingGrid.h"

#include "MTDredgingKiv.h"

void CMTDredgingGrid::Initialize(CZoSEDlgBase* dialog, CMTDredgingKiv* list) {
    CFemGridEditWnd::Initialize(dialog, list);
    SetColumnHeadings({"Dredger No.", "Name", "Include", "Edit"});
    Refresh();
}

void CMTDredgingGrid::Refresh() {
    Redraw();
    FitColumns();
    SizeToDialog();
}

void CMTDredgingGrid::GetStyleRowCol(int row, int col, CGridCellStyle& style) {
    // The row heading is the dredger's number; its name has a column of its own.
    if (row >= 1 && col == 0) {
        // Padded so that the row headings are as wide as the corner's "Dredger No.".
        CString text = FormatString("%d", row);
        const int wanted = fontMetrics().horizontalAdvance("Dredger No.");
        while (fontMetrics().horizontalAdvance(QString::fromStdString(text)) < wanted)
            text = " " + text + " ";
        style.SetStatic(text).SetAlign(ZoCellAlign::Center);
        return;
    }
    CFemGridEditWnd::GetStyleRowCol(row, col, style);
    if (row == 0)
        style.SetAlign(ZoCellAlign::Center);
}

void CMTDredgingGrid::GetItemStyle(CMTDredgingItemsKiv* item, int, int col, CGridCellStyle& style) {
    const bool included = item->Include() != 0;
    switch (col) {
    case 1:
        style.SetText(item->Name()).SetAlign(ZoCellAlign::Left).SetReadOnly(!included);
        break;
    case 2:
        style.SetCheckBox(included).SetAlign(ZoCellAlign::Center);
        break;
    case 3:
        style.SetButton(kGoToLabel).SetReadOnly(!included);
        break;
    default:
        break;
    }
}

int CMTDredgingGrid::StoreItem(CMTDredgingItemsKiv* item, int, int col, const CGridCellValue& value) {
    switch (col) {
    case 1:
        if (value.text == item->Name())
            return 0;
        item->Name(value.text);
        return kHintTitleChanged;
    case 2:
        item->Include(value.checked ? 1 : 0);
        return kHintValueChanged;
    default:
        return 0;
    }
}
