// The map: the mesh coloured by bed level with a legend, and layers of point, polyline and
// polygon features above it. Pan by dragging, zoom with the wheel; a click on a feature is
// reported, and the rectangle shown can be read and set again.
//
// A large mesh is never drawn element by element: the elements in view are found through a
// spatial index, and when too many are in view they are drawn in software into an image
// (once for the whole mesh at overview scales, else for the view) that repaints reuse.
#pragma once

#include "mesh/Mesh.h"

#include <QColor>
#include <QImage>
#include <QPolygonF>
#include <QWidget>

#include <memory>
#include <string>
#include <vector>

class CMeshIndex;

struct CZoMapFeature {
    enum Kind { kPoint, kPolyline, kPolygon };
    Kind kind = kPoint;
    int number = 0;   // the feature's number in its layer, from 1
    int subIndex = 0; // a part of what the feature stands for; 0 for the whole
    QString name;
    QPolygonF points; // in the map's projection
};

struct CZoMapOverlay {
    QString name;
    QColor colour;
    double lineWidth = 3;
    double pointSize = 10;
    bool visible = true;
    bool labels = true;
    std::vector<CZoMapFeature> features;
    int selected = 0; // number of the highlighted feature, 0 for none
};

// A feature found by a hit test: its layer and its place in the layer's list.
struct CZoMapHit {
    int overlay = -1;
    int feature = -1;
};

class CZoMapView : public QWidget {
    Q_OBJECT
public:
    explicit CZoMapView(QWidget* parent = nullptr);
    ~CZoMapView() override;

    // The mesh drawn, in the map's projection; null for none. The view keeps a reference.
    void SetMesh(MeshPtr mesh);
    const MeshPtr& Mesh() const { return m_mesh; }
    // The projection of the map (the domain's); features are transformed to it.
    void SetProjection(const std::string& projection) { m_projection = projection; }
    const std::string& Projection() const { return m_projection; }
    // A line shown over an empty map (why there is no mesh).
    void SetMessage(const QString& message);

    // Feature layers, drawn in the order added above the mesh.
    int AddOverlay(const QString& name, const QColor& colour);
    int OverlayCount() const { return static_cast<int>(m_overlays.size()); }
    CZoMapOverlay& Overlay(int overlay) { return m_overlays.at(static_cast<size_t>(overlay)); }
    const CZoMapOverlay& Overlay(int overlay) const {
        return m_overlays.at(static_cast<size_t>(overlay));
    }
    void RemoveOverlays();
    // Features in a registered projection, transformed to the map's. False, and nothing
    // added, when the projection is unknown or a point cannot be transformed.
    bool AddPoint(int overlay, int number, const QString& name, double x, double y,
                  const std::string& projection);
    bool AddPolyline(int overlay, int number, const QString& name, const std::vector<double>& x,
                     const std::vector<double>& y, const std::string& projection);
    bool AddPolygon(int overlay, int number, const QString& name, const std::vector<double>& x,
                    const std::vector<double>& y, const std::string& projection);

    // The features under a pixel, topmost layer first.
    std::vector<CZoMapHit> HitTest(QPointF pixel, double tolerance = 6) const;
    const CZoMapFeature& Feature(const CZoMapHit& hit) const;
    // Highlights feature number of a layer (0: none).
    void SelectFeature(int overlay, int number);

    // The world rectangle shown. Setting a null rectangle fits the map to the mesh.
    QRectF ViewRect() const;
    void SetViewRect(const QRectF& rect);
    // The mesh's extent, or the features' without a mesh.
    void FitToMesh();
    QPointF ToPixel(double x, double y) const;
    QPointF ToWorld(QPointF pixel) const;
    void ZoomBy(double factor, QPointF aroundPixel);
    void PanBy(QPointF pixels);
    // The mesh element under a pixel, or -1.
    int ElementAt(QPointF pixel) const;

    // How the mesh was drawn in the last frame, for tests and benchmarks.
    enum class MeshDraw { kNone, kOverview, kRaster, kElements };
    MeshDraw LastMeshDraw() const { return m_lastDraw; }
    // Draws the whole frame (what a repaint shows) with the painter.
    void Render(QPainter& painter);
    // What the last frame showed: the labels drawn (those that collided with another label,
    // the legend or the scale bar were left out), the legend's box and the scale bar's text.
    const std::vector<QRectF>& LabelRects() const { return m_labelRects; }
    const QRect& LegendRect() const { return m_legendRect; }
    const QString& ScaleBarText() const { return m_scaleText; }

signals:
    void featureClicked(int overlay, int number);
    void cursorMoved(double x, double y);
    void viewChanged(const QRectF& rect);
    void contextMenuRequested(QPoint globalPos, QPointF pixel);

protected:
    void paintEvent(QPaintEvent*) override;
    void resizeEvent(QResizeEvent*) override;
    void mousePressEvent(QMouseEvent*) override;
    void mouseMoveEvent(QMouseEvent*) override;
    void mouseReleaseEvent(QMouseEvent*) override;
    void wheelEvent(QWheelEvent*) override;
    void contextMenuEvent(QContextMenuEvent*) override;

private:
    bool AddFeature(int overlay, CZoMapFeature::Kind kind, int number, const QString& name,
                    std::vector<double> x, std::vector<double> y, const std::string& projection);
    QRectF FullExtent() const;
    void DrawMesh(QPainter& p);
    void DrawElements(QPainter& p, const QRectF& view);
    void DrawLegend(QPainter& p);
    void DrawOverlays(QPainter& p);
    void DrawLabels(QPainter& p);
    // Returns the rectangle the bar took.
    QRect DrawScaleBar(QPainter& p);
    void ViewChanged();

    MeshPtr m_mesh;
    std::unique_ptr<CMeshIndex> m_index;
    std::vector<uint32_t> m_colours;
    QImage m_overview; // the whole mesh, drawn once
    double m_overviewPixel = 0;
    QImage m_raster; // the view, drawn again when the view changes
    QPointF m_rasterCentre;
    double m_rasterScale = 0;
    std::string m_projection = "UTM-32";
    QString m_message;
    std::vector<CZoMapOverlay> m_overlays;

    QPointF m_centre;   // world point at the middle of the widget
    double m_scale = 0; // world units per pixel; 0 until the view is set
    QRectF m_pending;   // a rectangle set before the widget had a size
    bool m_fitPending = true;
    bool m_fitted = false; // fitted to the mesh and not moved since
    QPoint m_pressPos, m_lastPos;
    bool m_pressed = false, m_dragging = false;
    MeshDraw m_lastDraw = MeshDraw::kNone;
    std::vector<QRectF> m_labelRects;
    QRect m_legendRect;
    QRect m_scaleRect;
    QString m_scaleText;
};
