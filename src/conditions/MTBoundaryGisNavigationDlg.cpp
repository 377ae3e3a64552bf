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
    // A click on a boundary highlights it; its form opens from the menu's "Edit".
    connect(this, &CGisNavigationDlg::featureSelected, this, [this](int overlay, int number) {
        if (overlay == m_layer)
            Map()->SelectFeature(overlay, number);
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
    // Each boundary with its fractions, so that a fraction's value opens from the map too.
    const auto* list = Section<CMTBoundaryConditionsKiv>();
    return AddFeatureMenu(menu, hits, "Edit", [list](int number) {
        std::vector<QString> names;
        if (const CMTBoundaryConditionsComponentKiv* component = list ? list->GetItem(number) : nullptr)
            for (int f = 1; f <= component->GetItemCount(); ++f)
                names.push_back(QString::fromStdString(component->GetItem(f)->GetTitle()));
        return names;
    });
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
