#include "MTSourceItemGrid.h"

CMTSourceItemGrid::CMTSourceItemGrid(QWidget* parent) : CFemGridWnd(parent) {
    setObjectName("sourceItemGrid");
}

void CMTSourceItemGrid::Initialize(CZoSEDlgBase* dialog, CMTSourceItemKiv* source) {
    CFemGridWnd::Initialize(dialog, source);
    SetColumnHeadings({"Component", "Value/Item", ""});
}

CString CMTSourceItemGrid::ValueText(const CFemInDataKiv* value) {
    if (value->Format() == 0)
        return FormatString("Value: %g", value->Constant());
    CString file = value->QrdData()->FileName();
    const size_t slash = file.find_last_of("/\\");
    if (slash != CString::npos)
        file = file.substr(slash + 1);
    return "Item: " + value->QrdData()->ItemString() + " (File: " + file + ")";
}

void CMTSourceItemGrid::GetStyleRowCol(int row, int col, CGridCellStyle& style) {
    CFemGridWnd::GetStyleRowCol(row, col, style);
    if (col <= kValue && (row == 0 || col == 0))
        style.SetAlign(ZoCellAlign::Left);
}

void CMTSourceItemGrid::GetItemStyle(CMTSourceItemSubKiv* component, int, int col,
                                     CGridCellStyle& style) {
    if (col == kValue) {
        const CFemInDataKiv* value = component->Value();
        style.SetStatic(ValueText(value))
            .SetReadOnly()
            .SetAlign(value->Format() == 0 ? ZoCellAlign::Right : ZoCellAlign::Left);
    } else if (col == kEdit) {
        style.SetButton(kGoToLabel);
    }
}
