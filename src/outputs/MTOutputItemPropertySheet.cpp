#include "MTOutputItemPropertySheet.h"

#include "MTOutputItemMainKiv.h"
#include "MTOutputItemSubDischargeKiv.h"
#include "MTOutputItemSubKiv.h"
#include "MTOutputItemSubMassbudgetKiv.h"

#include <QTabWidget>

IMPLEMENT_DYNCREATE_DLG(CMTOutputItemPropertySheet)

int& CMTOutputItemPropertySheet::ActivePage() {
    static int page = 0;
    return page;
}

CMTOutputItemPropertySheet::CMTOutputItemPropertySheet(QWidget* parent) : CFemPropertySheetDlg(parent) {
    connect(Tabs(), &QTabWidget::currentChanged, this, [this](int index) {
        if (!m_building && index >= 0)
            ActivePage() = index;
    });
}

void CMTOutputItemPropertySheet::Initialize() {
    // Pages appear and the initial page is chosen without touching the remembered page.
    const bool was = m_building;
    m_building = true;
    AddPage("CMTOutputGisNavigationDlg", nullptr, "Geographic View");
    AddPage("CMTOutputItemMainDlg", nullptr, "Output specification");
    CFemPropertySheetDlg::Initialize();
    m_building = was;
}

void CMTOutputItemPropertySheet::SetData() {
    auto* output = Section<CMTOutputItemMainKiv>();
    if (output) {
        // The first selection in use decides the quantities page.
        CZoSEKivBase* node = nullptr;
        const char* page = nullptr;
        for (CZoSEKivBase* sub : std::initializer_list<CZoSEKivBase*>{
                 output->Parameters3D(), output->Parameters2D(), output->Discharge(), output->Massbudget()})
            if (sub->IsDlgUsedInSetup()) {
                node = sub;
                page = sub->GetDlgRuntimeClass(kDlgRuntimeClassRequest);
                break;
            }
        if (node != m_itemsNode || (node && GetPageCount() < 3)) {
            const bool was = m_building;
            m_building = true;
            if (GetPageCount() > 2) {
                QWidget* old = Tabs()->widget(2);
                Tabs()->removeTab(2);
                old->hide();
                old->deleteLater();
            }
            if (node)
                AddPage(page, node, "Output items");
            m_itemsNode = node;
            m_building = was;
        }
    }
    CFemPropertySheetDlg::SetData();
    const bool was = m_building;
    m_building = true;
    SetActivePage(std::min(ActivePage(), GetPageCount() - 1));
    m_building = was;
}
