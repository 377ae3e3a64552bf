#include "HDSourceGisPropSheet.h"

#include "fem/FemHelpListBase.h"

#include <QTabWidget>

IMPLEMENT_DYNCREATE_DLG(CHDSourceGisPropSheet)

int CHDSourceGisPropSheet::s_page = 0;
int CHDSourceGisPropSheet::s_feature = 0;

CHDSourceGisPropSheet::CHDSourceGisPropSheet(QWidget* parent) : CFemPropertySheetDlg(parent) {
    setObjectName("sourceSheet");
}

void CHDSourceGisPropSheet::Initialize() {
    AddPage("CHDSourceGisNavigationDlg", nullptr, "Geographic View");
    AddPage("CSourceDlg", nullptr, "List view");
    // Both pages have taken the source to show; the next sheet opens without one.
    s_feature = 0;
    CFemPropertySheetDlg::Initialize();
    SetActivePage(s_page < GetPageCount() ? s_page : 0);
    connect(Tabs(), &QTabWidget::currentChanged, this, [](int page) {
        if (page >= 0)
            s_page = page;
    });
}

unsigned long CHDSourceGisPropSheet::CurrentHelpID() const {
    const auto* help = dynamic_cast<const CFemHelpListBase*>(GetSection());
    const CZoSEDlgBase* page = GetPage(GetActiveIndex());
    const bool list = page && std::string(page->metaObject()->className()) == "CSourceDlg";
    const unsigned long id = help ? help->GetHelpID(list ? 1 : 0) : 0;
    return id != 0 ? id : CFemPropertySheetDlg::CurrentHelpID();
}

void CHDSourceGisPropSheet::SetInitialSelectedPage(int page) { s_page = page; }

void CHDSourceGisPropSheet::SetInitialSelectedFeature(int feature) { s_feature = feature; }
