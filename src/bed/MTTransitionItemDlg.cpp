#include "MTTransitionItemDlg.h"

#include "MTTransitionItemKiv.h"

IMPLEMENT_DYNCREATE_DLG(CMTTransitionItemDlg)

CMTTransitionItemDlg::CMTTransitionItemDlg(QWidget* parent) : CMTBedValueDlg(5042, parent) {}

CFemInDataKiv* CMTTransitionItemDlg::Value() const {
    auto* item = Section<CMTTransitionItemKiv>();
    return item ? item->Transition() : nullptr;
}
