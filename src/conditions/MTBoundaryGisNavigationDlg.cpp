#include "MTBoundaryGisNavigationDlg.h"

#include "MTBoundaryConditionsKiv.h"

#include <QAction>
#include <QMenu>

IMPLEMENT_DYNCREATE_DLG(CMTBoundaryGisNavigationDlg)

QRectF CMTBoundaryGisNavigationDlg::s_view;

CMTBoundaryGisNavigationDlg::CMTBoundaryGisNavigationDlg() {
    setObjectName("boundaryMap");
    HelpID(5013);
    ContourItem(2);
}

void CMTBoundaryGisNavigationDlg::Initialize() {
    CMeshNavigationDlg::Initialize();
    // A click on a boundary opens its form.
    connect(this, &CGisNavigationDlg::featureSelected, this, [this](int overlay, int number) {
        const auto* list = Section<CMTBoundaryConditionsKiv>();
        if (overlay == m_layer && list)
            SelectTreeItem(list->GetItem(number));
    });
}

void CMTBoundaryGisNavigationDlg::CreateOverlays() { m_layer = AddBoundaryOverlay(); }

int CMTBoundaryGisNavigationDlg::BuildContextMenu(QMenu& menu, QPointF pixel) {
    BuildDefaultMenu(menu);
    menu.addSeparator();
    std::vector<CZoMapHit> hits;
    for (const CZoMapHit& hit : HitTest(pixel))
        if (hit.overlay == m_layer)
            hits.push_back(hit);
    return AddFeatureMenu(menu, hits, "Edit");
}

void CMTBoundaryGisNavigationDlg::OnEditCommand(const QAction* action) {
    auto* list = Section<CMTBoundaryConditionsKiv>();
    if (!action || !list || !action->data().isValid())
        return;
    const int data = action->data().toInt();
    CMTBoundaryConditionsComponentKiv* component = list->GetItem(data >> 16);
    if (!component)
        return;
    const int sub = data & 0xffff;
    if (sub >= 1)
        SelectTreeItem(component->GetItem(sub));
    else
        SelectTreeItem(component);
}

void CMTBoundaryGisNavigationDlg::OnShowContextMenu(QWidget* owner, QPoint globalPos, QPointF pixel) {
    QMenu menu(owner);
    if (BuildContextMenu(menu, pixel) == 0) {
        menu.exec(globalPos);
        return;
    }
    QMenu* edit = menu.actions().back()->menu();
    const QAction* chosen = menu.exec(globalPos);
    // Entries of "Edit" open forms; the default entries act on their own.
    if (chosen && edit && edit->actions().contains(const_cast<QAction*>(chosen)))
        OnEditCommand(chosen);
}
