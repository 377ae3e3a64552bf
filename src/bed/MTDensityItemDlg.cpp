#include "MTDensityItemDlg.h"

#include "MTDensityItemKiv.h"

IMPLEMENT_DYNCREATE_DLG(CMTDensityItemDlg)

CMTDensityItemDlg::CMTDensityItemDlg(QWidget* parent) : CMTBedValueDlg(5017, parent) {}

CFemInDataKiv* CMTDensityItemDlg::Value() const {
    auto* item = Section<CMTDensityItemKiv>();
    return item ? item->Density() : nullptr;
}
