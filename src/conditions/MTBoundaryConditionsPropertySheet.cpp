#include "MTBoundaryConditionsPropertySheet.h"

#include <QTabWidget>

IMPLEMENT_DYNCREATE_DLG(CMTBoundaryConditionsPropertySheet)

int CMTBoundaryConditionsPropertySheet::s_page = 0;

CMTBoundaryConditionsPropertySheet::CMTBoundaryConditionsPropertySheet(QWidget* parent)
    : CFemPropertySheetDlg(parent) {
    setObjectName("boundaryConditionsSheet");
    HelpID(5016);
}

void CMTBoundaryConditionsPropertySheet::Initialize() {
    // The map page joins where the map view is built in; the list view is always there.
    AddPage("CMTBoundaryGisNavigationDlg", nullptr, "Geographic View");
    AddPage("CMTBoundaryConditionsDlg", nullptr, "List view");
    CFemPropertySheetDlg::Initialize();
    SetActivePage(s_page < GetPageCount() ? s_page : 0);
    connect(Tabs(), &QTabWidget::currentChanged, this,
            &CMTBoundaryConditionsPropertySheet::OnSetActive);
}

void CMTBoundaryConditionsPropertySheet::SetData() { CFemPropertySheetDlg::SetData(); }

void CMTBoundaryConditionsPropertySheet::OnSetActive(int page) {
    if (page >= 0)
        s_page = page;
}

void CMTBoundaryConditionsPropertySheet::SetInitialSelectedPage(int page) { s_page = page; }
