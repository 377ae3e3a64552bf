// The map page of an output: the mesh with the output's points, line or polygon. Every
// output's map page shows the same part of the map.
#pragma once

#include "widgets/GisNavigationDlg.h"

class CMTOutputGisNavigationDlg : public CGisNavigationDlg {
    Q_OBJECT
public:
    CMTOutputGisNavigationDlg();
    int OutputOverlay() const { return m_overlay; }
    static void ResetSharedView() { s_view = QRectF(); }

protected:
    void CreateOverlays() override;
    void SetView(const QRectF& rect) override { s_view = rect; }
    QRectF GetView() const override { return s_view; }

private:
    int m_overlay = -1;
    static QRectF s_view;
};
