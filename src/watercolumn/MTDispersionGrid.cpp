#include "MTDispersionGrid.h"

CMTDispersionGrid::CMTDispersionGrid(QWidget* parent) : CFemGridWnd(parent) {
    setObjectName("dispersionGrid");
}

void CMTDispersionGrid::Initialize(CZoSEDlgBase* dialog, CMTDispersionListKiv* list) {
    CFemGridWnd::Initialize(dialog, list);
    SetColumnHeadings({"Component", "Formulation", ""});
}

void CMTDispersionGrid::GetStyleRowCol(int row, int col, CGridCellStyle& style) {
    CFemGridWnd::GetStyleRowCol(row, col, style);
    if (row > 0 && col == 0)
        style.SetAlign(ZoCellAlign::Center);
}

void CMTDispersionGrid::GetItemStyle(CMTDispersionItemKiv* item, int, int col,
                                     CGridCellStyle& style) {
    switch (col) {
    case kFormulation:
        style.SetStatic(item->FormulationText()).SetReadOnly().SetAlign(ZoCellAlign::Center);
        break;
    case kEdit:
        style.SetButton(kGoToLabel);
        break;
    default:
        break;
    }
}
