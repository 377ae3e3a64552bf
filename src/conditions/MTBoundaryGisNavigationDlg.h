#pragma once

#include "widgets/GisNavigationDlg.h"

class QAction;

// The boundaries on the mesh. Its context menu lists the boundaries under the cursor, each
// with its fractions, to open their forms; every such page shows the extent the last one did.
class CMTBoundaryGisNavigationDlg : public CMeshNavigationDlg {
    Q_OBJECT
public:
    CMTBoundaryGisNavigationDlg();
    void Initialize() override;

    int BoundaryLayer() const { return m_layer; }
    // The menu at a pixel of the map: the default entries, a separator and "Edit" with the
    // features hit; returns the number of those.
    int BuildContextMenu(QMenu& menu, QPointF pixel);
    // A chosen "Edit" entry: the boundary (sub-index 0) or its fraction's value.
    void OnEditCommand(const QAction* action);
    static QRectF SharedView() { return s_view; }

protected:
    void CreateOverlays() override;
    void SetView(const QRectF& rect) override { s_view = rect; }
    QRectF GetView() const override { return s_view; }
    void OnShowContextMenu(QWidget* owner, QPoint globalPos, QPointF pixel) override;

private:
    int m_layer = -1;
    static QRectF s_view;
};
