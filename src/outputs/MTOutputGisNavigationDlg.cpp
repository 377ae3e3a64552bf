#include "MTOutputGisNavigationDlg.h"

#include "MTOutputItemMainKiv.h"

IMPLEMENT_DYNCREATE_DLG(CMTOutputGisNavigationDlg)

QRectF CMTOutputGisNavigationDlg::s_view;

CMTOutputGisNavigationDlg::CMTOutputGisNavigationDlg() { HelpID(5030); }

void CMTOutputGisNavigationDlg::CreateOverlays() {
    auto* output = Section<CMTOutputItemMainKiv>();
    m_overlay = -1;
    if (!output)
        return;
    CZoMapView* map = Map();
    m_overlay = map->AddOverlay("Output", QColor(200, 0, 160));
    // Coordinates are given in the output's projection; the map transforms them to the
    // domain's.
    const std::string projection = output->CoordinateType();
    if (output->UsesPoints()) {
        int number = 1;
        for (const MTOutputPoint& p : output->Points())
            map->AddPoint(m_overlay, number++, QString::fromStdString(p.name), p.x, p.y, projection);
    } else if (output->UsesLine()) {
        const MTOutputLine& l = output->Line();
        map->AddPolyline(m_overlay, 1, "Output", {l.xFirst, l.xLast}, {l.yFirst, l.yLast}, projection);
    } else if (!output->Polygon().empty()) {
        std::vector<double> x, y;
        for (const MTOutputCorner& c : output->Polygon()) {
            x.push_back(c.x);
            y.push_back(c.y);
        }
        map->AddPolygon(m_overlay, 1, "Output", x, y, projection);
    }
}
