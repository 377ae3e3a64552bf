#include "ZoMapView.h"

#include "mesh/MeshIndex.h"
#include "mesh/MeshRaster.h"
#include "projection/ZoMapProjection.h"

#include <QContextMenuEvent>
#include <QMouseEvent>
#include <QPainter>
#include <QPainterPath>
#include <QWheelEvent>

#include <algorithm>
#include <cmath>
#include <numbers>

namespace {
// More elements than this in view are drawn in software into an image.
constexpr size_t kElementLimit = 12000;
// The long side of the image of the whole mesh.
constexpr int kOverviewSize = 2048;

double SegmentDistance(QPointF p, QPointF a, QPointF b) {
    const QPointF d = b - a;
    const double len2 = QPointF::dotProduct(d, d);
    const double t = len2 > 0 ? std::clamp(QPointF::dotProduct(p - a, d) / len2, 0.0, 1.0) : 0.0;
    const QPointF q = a + t * d - p;
    return std::hypot(q.x(), q.y());
}
} // namespace

CZoMapView::CZoMapView(QWidget* parent) : QWidget(parent) {
    setMouseTracking(true);
    setMinimumSize(200, 150);
    setSizePolicy(QSizePolicy::Expanding, QSizePolicy::Expanding);
    setFocusPolicy(Qt::StrongFocus);
}

CZoMapView::~CZoMapView() = default;

void CZoMapView::SetMesh(MeshPtr mesh) {
    if (mesh == m_mesh)
        return;
    const bool first = !m_mesh;
    m_mesh = std::move(mesh);
    m_index.reset();
    m_colours.clear();
    m_overview = QImage();
    m_raster = QImage();
    if (m_mesh && m_mesh->ElementCount() > 0) {
        m_index = std::make_unique<CMeshIndex>(*m_mesh);
        m_colours = ElementColours(*m_mesh);
    }
    if (first && m_pending.isNull())
        m_fitPending = true;
    if (m_fitPending && width() > 0)
        FitToMesh();
    update();
}

void CZoMapView::SetMessage(const QString& message) {
    m_message = message;
    update();
}

int CZoMapView::AddOverlay(const QString& name, const QColor& colour) {
    CZoMapOverlay o;
    o.name = name;
    o.colour = colour;
    m_overlays.push_back(std::move(o));
    update();
    return OverlayCount() - 1;
}

void CZoMapView::RemoveOverlays() {
    m_overlays.clear();
    update();
}

bool CZoMapView::AddFeature(int overlay, CZoMapFeature::Kind kind, int number, const QString& name,
                            std::vector<double> x, std::vector<double> y,
                            const std::string& projection) {
    if (overlay < 0 || overlay >= OverlayCount() || x.empty() || x.size() != y.size())
        return false;
    const CZoMapProjection transform(projection, m_projection);
    if (!transform.IsValid() || !transform.Transform(x, y))
        return false;
    CZoMapFeature f;
    f.kind = kind;
    f.number = number;
    f.name = name;
    for (size_t i = 0; i < x.size(); ++i)
        f.points << QPointF(x[i], y[i]);
    Overlay(overlay).features.push_back(std::move(f));
    update();
    return true;
}

bool CZoMapView::AddPoint(int overlay, int number, const QString& name, double x, double y,
                          const std::string& projection) {
    return AddFeature(overlay, CZoMapFeature::kPoint, number, name, {x}, {y}, projection);
}

bool CZoMapView::AddPolyline(int overlay, int number, const QString& name,
                             const std::vector<double>& x, const std::vector<double>& y,
                             const std::string& projection) {
    return x.size() >= 2 &&
           AddFeature(overlay, CZoMapFeature::kPolyline, number, name, x, y, projection);
}

bool CZoMapView::AddPolygon(int overlay, int number, const QString& name,
                            const std::vector<double>& x, const std::vector<double>& y,
                            const std::string& projection) {
    return x.size() >= 3 &&
           AddFeature(overlay, CZoMapFeature::kPolygon, number, name, x, y, projection);
}

std::vector<CZoMapHit> CZoMapView::HitTest(QPointF pixel, double tolerance) const {
    std::vector<CZoMapHit> hits;
    for (int o = OverlayCount() - 1; o >= 0; --o) {
        const CZoMapOverlay& layer = Overlay(o);
        if (!layer.visible)
            continue;
        for (size_t i = 0; i < layer.features.size(); ++i) {
            const CZoMapFeature& f = layer.features[i];
            QPolygonF px;
            for (const QPointF& w : f.points)
                px << ToPixel(w.x(), w.y());
            bool hit = false;
            if (f.kind == CZoMapFeature::kPoint) {
                const QPointF d = px[0] - pixel;
                hit = std::hypot(d.x(), d.y()) <= tolerance + layer.pointSize / 2;
            } else {
                if (f.kind == CZoMapFeature::kPolygon)
                    hit = px.containsPoint(pixel, Qt::OddEvenFill);
                const int n = static_cast<int>(px.size());
                const int segments = f.kind == CZoMapFeature::kPolygon ? n : n - 1;
                for (int s = 0; s < segments && !hit; ++s)
                    hit = SegmentDistance(pixel, px[s], px[(s + 1) % n]) <=
                          tolerance + layer.lineWidth / 2;
            }
            if (hit)
                hits.push_back({o, static_cast<int>(i)});
        }
    }
    return hits;
}

const CZoMapFeature& CZoMapView::Feature(const CZoMapHit& hit) const {
    return Overlay(hit.overlay).features.at(static_cast<size_t>(hit.feature));
}

void CZoMapView::SelectFeature(int overlay, int number) {
    if (overlay < 0 || overlay >= OverlayCount() || Overlay(overlay).selected == number)
        return;
    Overlay(overlay).selected = number;
    update();
}

// --- view ------------------------------------------------------------------------------

QRectF CZoMapView::FullExtent() const {
    if (m_mesh && m_mesh->NodeCount() > 0) {
        const MeshExtent& e = m_mesh->Extent();
        return QRectF(QPointF(e.xMin, e.yMin), QPointF(e.xMax, e.yMax));
    }
    QRectF r;
    for (const CZoMapOverlay& o : m_overlays)
        for (const CZoMapFeature& f : o.features) {
            const QRectF b = f.points.boundingRect();
            r = r.isNull() ? b : r.united(b);
        }
    return r;
}

QRectF CZoMapView::ViewRect() const {
    if (m_scale <= 0)
        return m_pending;
    const double w = width() * m_scale, h = height() * m_scale;
    return QRectF(m_centre.x() - w / 2, m_centre.y() - h / 2, w, h);
}

void CZoMapView::SetViewRect(const QRectF& rect) {
    if (rect.isNull() || !rect.isValid() || !std::isfinite(rect.width()) ||
        !std::isfinite(rect.height())) {
        m_pending = QRectF();
        m_fitPending = true;
        if (width() > 0 && height() > 0)
            FitToMesh();
        return;
    }
    m_fitPending = false;
    m_fitted = false;
    if (width() <= 0 || height() <= 0 || !isVisible()) {
        m_pending = rect;
        if (width() <= 0 || height() <= 0)
            return;
    }
    m_centre = rect.center();
    m_scale = std::max(rect.width() / std::max(1, width()), rect.height() / std::max(1, height()));
    if (!(m_scale > 0))
        m_scale = 1;
    ViewChanged();
}

void CZoMapView::FitToMesh() {
    QRectF r = FullExtent();
    m_fitPending = false;
    m_fitted = true;
    if (r.isNull()) {
        m_centre = {0, 0};
        m_scale = 1;
        ViewChanged();
        return;
    }
    const double margin = std::max(std::max(r.width(), r.height()) * 0.04, 1.0);
    r.adjust(-margin, -margin, margin, margin);
    m_centre = r.center();
    m_scale = std::max(r.width() / std::max(1, width()), r.height() / std::max(1, height()));
    ViewChanged();
}

QPointF CZoMapView::ToPixel(double x, double y) const {
    const double s = m_scale > 0 ? m_scale : 1;
    return {width() / 2.0 + (x - m_centre.x()) / s, height() / 2.0 - (y - m_centre.y()) / s};
}

QPointF CZoMapView::ToWorld(QPointF p) const {
    const double s = m_scale > 0 ? m_scale : 1;
    return {m_centre.x() + (p.x() - width() / 2.0) * s,
            m_centre.y() - (p.y() - height() / 2.0) * s};
}

void CZoMapView::ZoomBy(double factor, QPointF around) {
    if (!(factor > 0) || m_scale <= 0)
        return;
    const QPointF before = ToWorld(around);
    // Not beyond a millimetre a pixel nor a thousand times the extent.
    const QRectF full = FullExtent();
    const double most = std::max({full.width(), full.height(), 1.0}) * 1000 / std::max(1, width());
    m_scale = std::clamp(m_scale / factor, 1e-3, most);
    m_fitted = false;
    const QPointF after = ToWorld(around);
    m_centre += before - after;
    ViewChanged();
}

void CZoMapView::PanBy(QPointF pixels) {
    m_centre += QPointF(-pixels.x() * m_scale, pixels.y() * m_scale);
    m_fitted = false;
    ViewChanged();
}

void CZoMapView::ViewChanged() {
    update();
    emit viewChanged(ViewRect());
}

int CZoMapView::ElementAt(QPointF pixel) const {
    if (!m_index)
        return -1;
    const QPointF w = ToWorld(pixel);
    return m_index->ElementAt(w.x(), w.y());
}

// --- drawing ---------------------------------------------------------------------------

void CZoMapView::paintEvent(QPaintEvent*) {
    QPainter p(this);
    Render(p);
}

void CZoMapView::Render(QPainter& p) {
    p.fillRect(rect(), QColor(236, 236, 232));
    DrawMesh(p);
    DrawOverlays(p);
    DrawLegend(p);
    m_scaleRect = DrawScaleBar(p);
    DrawLabels(p);
    if (!m_message.isEmpty()) {
        p.setPen(QColor(90, 90, 90));
        p.drawText(rect().adjusted(12, 12, -12, -12), Qt::AlignCenter | Qt::TextWordWrap,
                   m_message);
    }
}

void CZoMapView::DrawMesh(QPainter& p) {
    m_lastDraw = MeshDraw::kNone;
    if (!m_index || m_scale <= 0)
        return;
    const QRectF view = ViewRect();
    const size_t inView = m_index->CountIn(view.left(), view.top(), view.right(), view.bottom());
    if (inView <= kElementLimit) {
        DrawElements(p, view);
        m_lastDraw = MeshDraw::kElements;
        return;
    }
    const MeshExtent& e = m_mesh->Extent();
    if (m_overview.isNull()) {
        const double w = std::max(e.xMax - e.xMin, 1e-9), h = std::max(e.yMax - e.yMin, 1e-9);
        m_overviewPixel = std::max(w, h) / kOverviewSize;
        const int iw = std::max(1, static_cast<int>(std::ceil(w / m_overviewPixel)));
        const int ih = std::max(1, static_cast<int>(std::ceil(h / m_overviewPixel)));
        m_overview = QImage(iw, ih, QImage::Format_ARGB32_Premultiplied);
        m_overview.fill(Qt::transparent);
        RasteriseMesh(*m_index, m_colours, {e.xMin, e.yMax, m_overviewPixel, iw, ih},
                      reinterpret_cast<uint32_t*>(m_overview.bits()));
    }
    if (m_scale >= m_overviewPixel * 0.9) {
        // Only the part of the image in view, scaled without smoothing.
        const QRectF world = QRectF(QPointF(e.xMin, e.yMax - m_overview.height() * m_overviewPixel),
                                    QPointF(e.xMin + m_overview.width() * m_overviewPixel, e.yMax));
        const QRectF shown = world.intersected(view);
        if (!shown.isEmpty()) {
            const QRectF source((shown.left() - e.xMin) / m_overviewPixel,
                                (e.yMax - shown.bottom()) / m_overviewPixel,
                                shown.width() / m_overviewPixel, shown.height() / m_overviewPixel);
            const QRectF target(ToPixel(shown.left(), shown.bottom()),
                                ToPixel(shown.right(), shown.top()));
            p.drawImage(target, m_overview, source);
        }
        m_lastDraw = MeshDraw::kOverview;
        return;
    }
    if (m_raster.size() != size() || m_rasterScale != m_scale || m_rasterCentre != m_centre) {
        m_raster = QImage(size(), QImage::Format_ARGB32_Premultiplied);
        m_raster.fill(Qt::transparent);
        RasteriseMesh(*m_index, m_colours, {view.left(), view.bottom(), m_scale, width(), height()},
                      reinterpret_cast<uint32_t*>(m_raster.bits()));
        m_rasterScale = m_scale;
        m_rasterCentre = m_centre;
    }
    p.drawImage(0, 0, m_raster);
    m_lastDraw = MeshDraw::kRaster;
}

void CZoMapView::DrawElements(QPainter& p, const QRectF& view) {
    const CMesh& m = *m_mesh;
    size_t count = 0;
    double size = 0;
    // Outlines only where elements are large enough to show them.
    m_index->ForEach(view.left(), view.top(), view.right(), view.bottom(), [&](int e) {
        if (count++ < 64) {
            const CMesh::Element& el = m.elements[static_cast<size_t>(e)];
            size += std::abs(m.x[static_cast<size_t>(el[1])] - m.x[static_cast<size_t>(el[0])]) +
                    std::abs(m.y[static_cast<size_t>(el[1])] - m.y[static_cast<size_t>(el[0])]);
        }
    });
    const bool outlines = count > 0 && size / std::min<size_t>(count, 64) / m_scale > 8;
    p.save();
    p.setRenderHint(QPainter::Antialiasing, false);
    QPen edge(QColor(60, 60, 60, 110), 0);
    m_index->ForEach(view.left(), view.top(), view.right(), view.bottom(), [&](int e) {
        const CMesh::Element& el = m.elements[static_cast<size_t>(e)];
        const int n = CMesh::Corners(el);
        QPointF pts[4];
        for (int i = 0; i < n; ++i)
            pts[i] = ToPixel(m.x[static_cast<size_t>(el[i])], m.y[static_cast<size_t>(el[i])]);
        const QColor c = QColor::fromRgba(m_colours[static_cast<size_t>(e)]);
        p.setBrush(c);
        p.setPen(outlines ? edge : QPen(c, 0));
        p.drawPolygon(pts, n);
    });
    p.restore();
}

void CZoMapView::DrawLegend(QPainter& p) {
    m_legendRect = QRect();
    if (!m_mesh || m_mesh->NodeCount() == 0)
        return;
    const MeshExtent& e = m_mesh->Extent();
    const bool levels = m_mesh->HasBedLevel(), noData = m_mesh->MissingBedLevelCount() > 0;
    const QFontMetrics fm = p.fontMetrics();
    const int barH = levels ? std::min(100, height() / 3) : 0, barW = 12;
    const int noDataH = noData ? fm.height() + 4 : 0;
    const QString top = QString::number(e.zMax, 'f', 1) + " m",
                  bottom = QString::number(e.zMin, 'f', 1) + " m", none = tr("no data");
    const QString title = tr("Bed level");
    const int textW = std::max({fm.horizontalAdvance(top), fm.horizontalAdvance(bottom),
                                fm.horizontalAdvance(title), fm.horizontalAdvance(none)});
    const QRect box(width() - textW - barW - 28, height() - barH - noDataH - fm.height() - 26,
                    textW + barW + 20, barH + noDataH + fm.height() + 18);
    m_legendRect = box;
    p.save();
    p.setPen(QColor(0, 0, 0, 60));
    p.setBrush(QColor(255, 255, 255, 210));
    p.drawRect(box);
    p.setPen(Qt::black);
    p.drawText(box.left() + 6, box.top() + fm.ascent() + 4, title);
    const int x = box.left() + 6, y0 = box.top() + fm.height() + 10;
    if (levels) {
        for (int i = 0; i < barH; ++i) {
            const double z = e.zMax - (e.zMax - e.zMin) * i / std::max(1, barH - 1);
            p.fillRect(x, y0 + i, barW, 1, QColor::fromRgba(BedLevelColour(z, e.zMin, e.zMax)));
        }
        p.drawText(x + barW + 4, y0 + fm.ascent() / 2 + 2, top);
        p.drawText(x + barW + 4, y0 + barH, bottom);
    }
    if (noData) {
        const int y = y0 + barH + (levels ? 4 : 0);
        p.fillRect(x, y, barW, fm.height() - 2, QColor::fromRgba(kNoBedLevelColour));
        p.drawText(x + barW + 4, y + fm.ascent() - 1, none);
    }
    p.restore();
}

void CZoMapView::DrawOverlays(QPainter& p) {
    p.save();
    p.setRenderHint(QPainter::Antialiasing, true);
    for (const CZoMapOverlay& o : m_overlays) {
        if (!o.visible)
            continue;
        for (const CZoMapFeature& f : o.features) {
            const bool selected = o.selected != 0 && f.number == o.selected;
            QPolygonF px;
            for (const QPointF& w : f.points)
                px << ToPixel(w.x(), w.y());
            if (!QRectF(rect())
                     .adjusted(-50, -50, 50, 50)
                     .intersects(px.boundingRect().adjusted(-1, -1, 1, 1)))
                continue;
            const double width = o.lineWidth + (selected ? 3 : 0);
            if (selected) {
                p.setPen(QPen(QColor(255, 215, 0), width + 4, Qt::SolidLine, Qt::RoundCap,
                              Qt::RoundJoin));
                p.setBrush(Qt::NoBrush);
                if (f.kind == CZoMapFeature::kPoint)
                    p.drawEllipse(px[0], o.pointSize / 2 + 4, o.pointSize / 2 + 4);
                else if (f.kind == CZoMapFeature::kPolygon)
                    p.drawPolygon(px);
                else
                    p.drawPolyline(px);
            }
            p.setPen(QPen(o.colour, width, Qt::SolidLine, Qt::RoundCap, Qt::RoundJoin));
            switch (f.kind) {
            case CZoMapFeature::kPoint:
                p.setPen(QPen(Qt::white, 1.5));
                p.setBrush(o.colour);
                p.drawEllipse(px[0], o.pointSize / 2, o.pointSize / 2);
                break;
            case CZoMapFeature::kPolyline:
                p.setBrush(Qt::NoBrush);
                p.drawPolyline(px);
                break;
            case CZoMapFeature::kPolygon: {
                QColor fill = o.colour;
                fill.setAlpha(60);
                p.setBrush(fill);
                p.drawPolygon(px);
                break;
            }
            }
        }
    }
    p.restore();
}

namespace {
// A length of 1, 2 or 5 times a power of ten, at most the given one.
double NiceLength(double most) {
    if (!(most > 0))
        return 0;
    const double power = std::pow(10.0, std::floor(std::log10(most)));
    for (double step : {5.0, 2.0, 1.0})
        if (step * power <= most)
            return step * power;
    return power;
}
}  // namespace

QRect CZoMapView::DrawScaleBar(QPainter& p) {
    m_scaleText.clear();
    if (m_scale <= 0 || width() < 120)
        return {};
    // Metres per pixel; a degree of latitude is about 111.32 km, one of longitude less by
    // the cosine of the latitude in the middle of the view.
    double metres = m_scale;
    if (CZoMapProjection::IsGeographical(m_projection))
        metres *= 111320.0 * std::cos(std::clamp(m_centre.y(), -89.0, 89.0) * std::numbers::pi / 180.0);
    const double length = NiceLength(metres * std::min(120, width() / 4));
    if (length <= 0)
        return {};
    const int bar = static_cast<int>(std::lround(length / metres));
    m_scaleText = length >= 1000 ? QStringLiteral("%1 km").arg(length / 1000) : QStringLiteral("%1 m").arg(length);
    const QFontMetrics fm = p.fontMetrics();
    const QRect box(10, height() - fm.height() - 26, std::max(bar, fm.horizontalAdvance(m_scaleText)) + 12,
                    fm.height() + 16);
    p.save();
    p.setPen(QColor(0, 0, 0, 60));
    p.setBrush(QColor(255, 255, 255, 210));
    p.drawRect(box);
    const int y = box.bottom() - 6;
    p.setPen(QPen(Qt::black, 2));
    p.drawLine(box.left() + 6, y, box.left() + 6 + bar, y);
    p.drawLine(box.left() + 6, y - 4, box.left() + 6, y);
    p.drawLine(box.left() + 6 + bar, y - 4, box.left() + 6 + bar, y);
    p.drawText(box.left() + 6, box.top() + fm.ascent() + 2, m_scaleText);
    p.restore();
    return box;
}

// Labels go beside their feature where they collide with nothing drawn before them: the
// highlighted features' first, then layer by layer; one that finds no free place is left
// out, so crowded labels thin out instead of covering each other.
void CZoMapView::DrawLabels(QPainter& p) {
    m_labelRects.clear();
    const QFontMetricsF fm(p.fontMetrics());
    const QRectF area = QRectF(rect()).adjusted(2, 2, -2, -2);
    std::vector<QRectF> blocked;
    if (!m_legendRect.isNull())
        blocked.push_back(m_legendRect);
    if (!m_scaleRect.isNull())
        blocked.push_back(m_scaleRect);
    auto place = [&](const CZoMapOverlay& o, const CZoMapFeature& f) {
        if (f.points.isEmpty())
            return;
        const QPointF w = f.kind == CZoMapFeature::kPolyline ? f.points[f.points.size() / 2] : f.points[0];
        const QPointF at = ToPixel(w.x(), w.y());
        if (!area.contains(at))
            return;
        const QSizeF size(fm.horizontalAdvance(f.name) + 4, fm.height());
        const double gap = o.pointSize / 2 + 4;
        const QPointF corners[] = {at + QPointF(gap, -size.height()),
                                   at + QPointF(-gap - size.width(), -size.height()),
                                   at + QPointF(gap, 2),
                                   at + QPointF(-gap - size.width(), 2),
                                   at + QPointF(-size.width() / 2, -gap - size.height()),
                                   at + QPointF(-size.width() / 2, gap)};
        for (const QPointF& corner : corners) {
            const QRectF r(corner, size);
            if (!area.contains(r) ||
                std::any_of(blocked.begin(), blocked.end(), [&](const QRectF& b) { return b.intersects(r); }))
                continue;
            blocked.push_back(r);
            m_labelRects.push_back(r);
            // A light halo keeps the text readable over the mesh.
            p.setPen(QColor(255, 255, 255, 200));
            for (const QPointF& d : {QPointF(-1, 0), QPointF(1, 0), QPointF(0, -1), QPointF(0, 1)})
                p.drawText(r.translated(d), Qt::AlignCenter, f.name);
            p.setPen(QColor(20, 20, 20));
            p.drawText(r, Qt::AlignCenter, f.name);
            return;
        }
    };
    p.save();
    for (bool selected : {true, false})
        for (const CZoMapOverlay& o : m_overlays) {
            if (!o.visible || !o.labels)
                continue;
            for (const CZoMapFeature& f : o.features)
                if (!f.name.isEmpty() && (o.selected != 0 && f.number == o.selected) == selected)
                    place(o, f);
        }
    p.restore();
}

// --- events ----------------------------------------------------------------------------

void CZoMapView::resizeEvent(QResizeEvent*) {
    // A map fitted to the mesh stays fitted until the user moves it.
    if (m_fitPending || m_fitted) {
        FitToMesh();
    } else if (!m_pending.isNull()) {
        const QRectF r = m_pending;
        m_pending = QRectF();
        SetViewRect(r);
    } else if (m_scale > 0) {
        ViewChanged();
    }
}

void CZoMapView::mousePressEvent(QMouseEvent* e) {
    if (e->button() != Qt::LeftButton)
        return QWidget::mousePressEvent(e);
    m_pressed = true;
    m_dragging = false;
    m_pressPos = m_lastPos = e->position().toPoint();
}

void CZoMapView::mouseMoveEvent(QMouseEvent* e) {
    const QPoint pos = e->position().toPoint();
    if (m_pressed) {
        if ((pos - m_pressPos).manhattanLength() > 3)
            m_dragging = true;
        if (m_dragging) {
            PanBy(pos - m_lastPos);
            m_lastPos = pos;
        }
    }
    const QPointF w = ToWorld(pos);
    emit cursorMoved(w.x(), w.y());
}

void CZoMapView::mouseReleaseEvent(QMouseEvent* e) {
    if (e->button() != Qt::LeftButton || !m_pressed)
        return QWidget::mouseReleaseEvent(e);
    m_pressed = false;
    if (m_dragging)
        return;
    const std::vector<CZoMapHit> hits = HitTest(e->position());
    if (!hits.empty())
        emit featureClicked(hits.front().overlay, Feature(hits.front()).number);
}

void CZoMapView::wheelEvent(QWheelEvent* e) {
    const int steps = e->angleDelta().y();
    if (steps == 0)
        return;
    ZoomBy(std::pow(1.0015, steps), e->position());
    e->accept();
}

void CZoMapView::contextMenuEvent(QContextMenuEvent* e) {
    emit contextMenuRequested(e->globalPos(), e->pos());
    e->accept();
}
