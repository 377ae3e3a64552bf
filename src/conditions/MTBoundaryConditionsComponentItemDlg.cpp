#include "MTBoundaryConditionsComponentItemDlg.h"

IMPLEMENT_DYNCREATE_DLG(CMTBoundaryConditionsComponentItemDlg)

CMTBoundaryConditionsComponentItemDlg::CMTBoundaryConditionsComponentItemDlg(QWidget* parent)
    : CBoundaryConditionsComponentItemDlg(parent) {
    HelpID(5015);
}
