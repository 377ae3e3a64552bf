#include "HDSourceGisNavigationDlg.h"

#include "HDSourceGisPropSheet.h"
#include "setupeditor/ZoSEKivListBase.h"

IMPLEMENT_DYNCREATE_DLG(CHDSourceGisNavigationDlg)

CHDSourceGisNavigationDlg::CHDSourceGisNavigationDlg() {
    setObjectName("sourceMap");
    HelpID(5037);
}

void CHDSourceGisNavigationDlg::Initialize() {
    m_feature = CHDSourceGisPropSheet::GetInitialSelectedFeature();
    CMeshNavigationDlg::Initialize();
    connect(this, &CGisNavigationDlg::featureSelected, this, [this](int overlay, int number) {
        if (overlay != m_layer)
            return;
        if (auto* list = Section<CZoSEKivListBaseInterface>())
            SelectTreeItem(list->GetItemNode(number));
    });
}

void CHDSourceGisNavigationDlg::CreateOverlays() { m_layer = AddSourceOverlay(); }

void CHDSourceGisNavigationDlg::SetData() {
    CMeshNavigationDlg::SetData();
    if (m_layer >= 0 && m_feature > 0)
        Map()->SelectFeature(m_layer, m_feature);
}
