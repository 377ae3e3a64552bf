#include "MTDepositionGrid.h"

CMTDepositionGrid::CMTDepositionGrid(QWidget* parent) : CFemGridWnd(parent) {
    setObjectName("depositionGrid");
}

void CMTDepositionGrid::Initialize(CZoSEDlgBase* dialog, CMTDepositionKiv* section) {
    CFemGridWnd::Initialize(dialog, section);
    SetColumnHeadings({"Fraction", "Format", "Edit"});
}

void CMTDepositionGrid::GetItemStyle(CMTDepositionItemKiv* item, int, int col,
                                     CGridCellStyle& style) {
    switch (col) {
    case kFormat:
        style.SetStatic(item->CriticalShearStress()->FormatText()).SetReadOnly();
        break;
    case kEdit:
        style.SetButton(kGoToLabel);
        break;
    default:
        break;
    }
}
