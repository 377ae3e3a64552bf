// The map drawn offscreen: the example mesh and features land where their coordinates say,
// clicks and hit tests name the features, pan and zoom keep the point under the cursor,
// pages of one kind share their view, and large meshes are drawn from images.
#include "fem/DomainKiv.h"
#include "host/SetupDocument.h"
#include "hydro/HDSourcesKiv.h"
#include "mesh/MeshIndex.h"
#include "mesh/MeshRaster.h"
#include "mesh/MeshReader.h"
#include "projection/ZoMapProjection.h"
#include "support/UiTestSupport.h"
#include "widgets/GisNavigationDlg.h"

#include <QImage>
#include <QLineF>
#include <QPainter>
#include <QRegularExpression>
#include <QSignalSpy>
#include <QTest>

#include <gtest/gtest.h>

namespace {

const std::string kMeshFile = MUD_SOURCE_DIR "/examples/estuary.2dm";

MeshPtr ExampleMesh() {
    static const MeshReadResult r = ReadMeshFile(kMeshFile);
    EXPECT_TRUE(r.mesh) << r.error;
    return r.mesh;
}

QImage Draw(CZoMapView& view) {
    QImage image(view.size(), QImage::Format_ARGB32_Premultiplied);
    QPainter p(&image);
    view.Render(p);
    return image;
}

struct MapFixture : ::testing::Test {
    void SetUp() override {
        view.resize(800, 500);
        view.SetMesh(ExampleMesh());
        view.SetProjection("UTM-32");
        view.FitToMesh();
    }
    CZoMapView view;
};

TEST_F(MapFixture, MeshAndFeaturesLandAtTheirPixels) {
    // A harbour given in longitude and latitude, a line and a polygon in UTM-32.
    const int layer = view.AddOverlay("Test", QColor(255, 0, 255));
    view.Overlay(layer).labels = false;
    const double lon = 8.72, lat = 53.87;
    ASSERT_TRUE(view.AddPoint(layer, 1, "Harbour", lon, lat, "LONG/LAT"));
    ASSERT_TRUE(view.AddPolyline(layer, 2, "Line", {500000, 520000}, {5950000, 5950000}, "UTM-32"));
    ASSERT_TRUE(view.AddPolygon(layer, 3, "Area", {540000, 545000, 545000},
                                {5935000, 5935000, 5940000}, "UTM-32"));
    EXPECT_FALSE(view.AddPoint(layer, 4, "Nowhere", 1, 2, "MERCATOR"));
    EXPECT_EQ(view.Overlay(layer).features.size(), 3u);

    const QImage image = Draw(view);
    const QRgb magenta = qRgb(255, 0, 255);
    double x = lon, y = lat;
    ASSERT_TRUE(CZoMapProjection("LONG/LAT", "UTM-32").Transform(x, y));
    const QPoint harbour = view.ToPixel(x, y).toPoint();
    ASSERT_TRUE(image.rect().contains(harbour));
    EXPECT_EQ(image.pixel(harbour), magenta);
    EXPECT_EQ(image.pixel(view.ToPixel(510000, 5950000).toPoint()), magenta);
    // Inside the polygon its colour is mixed with the mesh beneath.
    const QColor inside = image.pixelColor(view.ToPixel(544000, 5936000).toPoint());
    EXPECT_GT(inside.red(), inside.green());

    // An element away from the features shows its bed-level colour; outside the mesh the
    // background shows.
    const CMesh& m = *ExampleMesh();
    const std::vector<uint32_t> colours = ElementColours(m);
    const int e = 1500;
    const CMesh::Element& el = m.elements[e];
    double cx = 0, cy = 0;
    for (int i = 0; i < CMesh::Corners(el); ++i)
        cx += m.x[el[i]] / CMesh::Corners(el), cy += m.y[el[i]] / CMesh::Corners(el);
    EXPECT_EQ(image.pixel(view.ToPixel(cx, cy).toPoint()), colours[e]);
    EXPECT_EQ(view.ElementAt(view.ToPixel(cx, cy)), e);
    EXPECT_EQ(image.pixel(5, 5), qRgb(236, 236, 232));

    // The same frame through a repaint of the widget.
    view.show();
    ASSERT_TRUE(QTest::qWaitForWindowExposed(&view));
    EXPECT_EQ(view.grab().toImage().convertToFormat(QImage::Format_RGB32).pixel(harbour), magenta);
}

TEST_F(MapFixture, HitTestsAndClicksNameTheFeature) {
    const int boundaries = view.AddOverlay("Boundaries", Qt::red);
    const int points = view.AddOverlay("Points", Qt::blue);
    const MeshBoundary& sea = ExampleMesh()->boundaries[0];
    std::vector<double> bx, by;
    for (int n : sea.nodes)
        bx.push_back(ExampleMesh()->x[n]), by.push_back(ExampleMesh()->y[n]);
    ASSERT_TRUE(view.AddPolyline(boundaries, 1, "Sea boundary", bx, by, "UTM-32"));
    ASSERT_TRUE(view.AddPoint(points, 7, "Source", bx[8], by[8], "UTM-32"));
    ASSERT_TRUE(view.AddPoint(points, 8, "Far", 520000, 5950000, "UTM-32"));

    // The point lies on the line: both are hit, the upper layer first.
    const QPointF onBoth = view.ToPixel(bx[8], by[8]);
    std::vector<CZoMapHit> hits = view.HitTest(onBoth);
    ASSERT_EQ(hits.size(), 2u);
    EXPECT_EQ(view.Feature(hits[0]).name, "Source");
    EXPECT_EQ(view.Feature(hits[1]).name, "Sea boundary");
    hits = view.HitTest(view.ToPixel(bx[2], by[2]) + QPointF(2, 0));
    ASSERT_EQ(hits.size(), 1u);
    EXPECT_EQ(view.Feature(hits[0]).number, 1);
    EXPECT_TRUE(view.HitTest(view.ToPixel(520000, 5950000) + QPointF(30, 30)).empty());
    view.Overlay(points).visible = false;
    EXPECT_EQ(view.HitTest(onBoth).size(), 1u);
    view.Overlay(points).visible = true;

    view.show();
    ASSERT_TRUE(QTest::qWaitForWindowExposed(&view));
    QSignalSpy clicked(&view, &CZoMapView::featureClicked);
    QTest::mouseClick(&view, Qt::LeftButton, {}, view.ToPixel(520000, 5950000).toPoint());
    ASSERT_EQ(clicked.size(), 1);
    EXPECT_EQ(clicked[0][0].toInt(), points);
    EXPECT_EQ(clicked[0][1].toInt(), 8);
}

// Labels never cover each other, the legend or the scale bar: crowded ones thin out and the
// highlighted feature's label comes first. The scale bar names a round length.
TEST_F(MapFixture, LabelsAvoidEachOtherAndTheLegendAndAScaleBarIsDrawn) {
    const int layer = view.AddOverlay("Points", Qt::blue);
    for (int i = 1; i <= 8; ++i)
        ASSERT_TRUE(view.AddPoint(layer, i, QStringLiteral("Station number %1").arg(i), 510000 + i, 5950000,
                                  "UTM-32"));
    // One under the legend, in the bottom right corner.
    const QPointF corner = view.ToWorld(QPointF(view.width() - 30, view.height() - 30));
    ASSERT_TRUE(view.AddPoint(layer, 9, "Hidden by the legend", corner.x(), corner.y(), "UTM-32"));
    view.SelectFeature(layer, 8);
    Draw(view);

    const std::vector<QRectF>& labels = view.LabelRects();
    ASSERT_FALSE(labels.empty());
    EXPECT_LT(labels.size(), 9u);
    EXPECT_FALSE(view.LegendRect().isNull());
    for (size_t i = 0; i < labels.size(); ++i) {
        EXPECT_TRUE(QRectF(view.rect()).contains(labels[i]));
        EXPECT_FALSE(labels[i].intersects(view.LegendRect()));
        for (size_t j = i + 1; j < labels.size(); ++j)
            EXPECT_FALSE(labels[i].intersects(labels[j])) << i << " and " << j;
    }
    // The highlighted station's label is placed first, beside its point.
    const QPointF selected = view.ToPixel(510008, 5950000);
    EXPECT_LT(QLineF(labels[0].center(), selected).length(), 120);

    const QString scale = view.ScaleBarText();
    EXPECT_TRUE(QRegularExpression("^[125]0* k?m$").match(scale).hasMatch()) << scale.toStdString();
    view.ZoomBy(4, QPointF(400, 250));
    Draw(view);
    EXPECT_NE(view.ScaleBarText(), scale);
}

TEST_F(MapFixture, PanZoomAndViewRectangles) {
    const QPointF cursor(200, 150);
    const QPointF before = view.ToWorld(cursor);
    view.ZoomBy(4, cursor);
    EXPECT_NEAR(view.ToWorld(cursor).x(), before.x(), 1e-6);
    EXPECT_NEAR(view.ToWorld(cursor).y(), before.y(), 1e-6);
    const QRectF zoomed = view.ViewRect();
    view.PanBy(QPointF(100, 0));
    EXPECT_NEAR(view.ViewRect().left(), zoomed.left() - 100 * zoomed.width() / view.width(), 1e-6);

    // A stored rectangle comes back: the whole of it in view, centred.
    const QRectF stored(500000, 5940000, 10000, 10000);
    view.SetViewRect(stored);
    EXPECT_TRUE(view.ViewRect().contains(stored.adjusted(1, 1, -1, -1)));
    EXPECT_NEAR(view.ViewRect().center().x(), stored.center().x(), 1e-6);
    EXPECT_NEAR(view.ViewRect().height(), stored.height(), 1e-6);
    // A null rectangle fits the mesh.
    view.SetViewRect(QRectF());
    const MeshExtent& ext = ExampleMesh()->Extent();
    EXPECT_TRUE(
        view.ViewRect().contains(QRectF(QPointF(ext.xMin, ext.yMin), QPointF(ext.xMax, ext.yMax))));

    // Wheel and drag as a user does them.
    view.show();
    ASSERT_TRUE(QTest::qWaitForWindowExposed(&view));
    const double scale = view.ViewRect().width();
    QWheelEvent wheel(cursor, view.mapToGlobal(cursor), {}, QPoint(0, 240), Qt::NoButton, {},
                      Qt::NoScrollPhase, false);
    QApplication::sendEvent(&view, &wheel);
    EXPECT_LT(view.ViewRect().width(), scale);
    const QPointF grabbed = view.ToWorld(QPointF(300, 300));
    QTest::mousePress(&view, Qt::LeftButton, {}, QPoint(300, 300));
    QTest::mouseMove(&view, QPoint(340, 320));
    QTest::mouseMove(&view, QPoint(400, 350));
    QTest::mouseRelease(&view, Qt::LeftButton, {}, QPoint(400, 350));
    EXPECT_NEAR(view.ToWorld(QPointF(400, 350)).x(), grabbed.x(), 1e-6);
    EXPECT_NEAR(view.ToWorld(QPointF(400, 350)).y(), grabbed.y(), 1e-6);
}

TEST(MapDraw, LargeMeshesAreDrawnFromImagesAndCloseUpElementByElement) {
    // 200 000 triangles on a 10 m grid.
    auto mesh = std::make_shared<CMesh>();
    const int side = 317;
    for (int j = 0; j < side; ++j)
        for (int i = 0; i < side; ++i) {
            mesh->x.push_back(10.0 * i);
            mesh->y.push_back(10.0 * j);
            mesh->z.push_back(-1.0 - i * 0.01);
        }
    for (int j = 0; j + 1 < side; ++j)
        for (int i = 0; i + 1 < side; ++i) {
            const int a = j * side + i;
            mesh->elements.push_back({a, a + 1, a + side + 1, -1});
            mesh->elements.push_back({a, a + side + 1, a + side, -1});
        }
    mesh->Finish();
    CZoMapView view;
    view.resize(600, 400);
    view.SetMesh(mesh);
    view.FitToMesh();
    const QImage full = Draw(view);
    EXPECT_EQ(view.LastMeshDraw(), CZoMapView::MeshDraw::kOverview);
    // Every pixel inside the mesh is covered.
    const QPoint inside = view.ToPixel(1580, 1580).toPoint();
    EXPECT_EQ(qAlpha(full.pixel(inside)), 255);
    EXPECT_NE(full.pixel(inside), qRgb(236, 236, 232));

    view.SetViewRect(QRectF(1000, 1000, 400, 300));
    const QImage close = Draw(view);
    EXPECT_EQ(view.LastMeshDraw(), CZoMapView::MeshDraw::kElements);
    const CMeshIndex index(*mesh);
    const int e = index.ElementAt(1203.0, 1201.0);
    ASSERT_GE(e, 0);
    EXPECT_EQ(close.pixel(view.ToPixel(1203.0, 1201.0).toPoint()), ElementColours(*mesh)[e]);

    // Finer than the image of the whole mesh, but too many elements to draw one by one.
    view.resize(1200, 800);
    view.SetViewRect(QRectF(0, 0, 1400, 930));
    Draw(view);
    EXPECT_EQ(view.LastMeshDraw(), CZoMapView::MeshDraw::kRaster);
}

// A map page kind that keeps one view for all its pages, as the module's map pages do.
class CSharedViewPage : public CMeshNavigationDlg {
public:
    static QRectF s_view;

protected:
    void SetView(const QRectF& r) override { s_view = r; }
    QRectF GetView() const override { return s_view; }
};
QRectF CSharedViewPage::s_view;

TEST(MapPage, ShowsTheDomainsMeshBoundariesAndSourcesAndKeepsTheViewOfItsKind) {
    CSetupDocument doc;
    CDomainKiv* domain = doc.GetDomain();
    std::string error;
    ASSERT_TRUE(domain->LoadMesh("estuary.2dm", kMeshFile, &error)) << error;
    CHDSourceItemKiv* source = doc.GetSources()->Append();
    source->Name("Outfall");
    source->X(513200.0);
    source->Y(5950300.0);
    uitest::CRecordingHost host;
    host.setupDir = MUD_SOURCE_DIR "/examples";

    auto open = [&] {
        auto page = std::make_unique<CSharedViewPage>();
        page->Attach(doc.GetSources(), &host);
        page->resize(700, 500);
        page->Initialize();
        page->show();
        EXPECT_TRUE(QTest::qWaitForWindowExposed(page.get()));
        return page;
    };
    auto page = open();
    CZoMapView* map = page->Map();
    EXPECT_EQ(map->Mesh(), domain->Mesh()); // the domain's mesh, not a copy
    ASSERT_GE(page->BoundaryOverlay(), 0);
    ASSERT_GE(page->SourceOverlay(), 0);
    const auto& lines = map->Overlay(page->BoundaryOverlay()).features;
    ASSERT_EQ(lines.size(), 3u);
    EXPECT_EQ(lines[2].name, "River Oste");
    EXPECT_EQ(lines[2].number, 3);
    const auto& points = map->Overlay(page->SourceOverlay()).features;
    ASSERT_EQ(points.size(), 1u);
    QSignalSpy selected(page.get(), &CGisNavigationDlg::featureSelected);
    QTest::mouseClick(map, Qt::LeftButton, {}, map->ToPixel(513200.0, 5950300.0).toPoint());
    ASSERT_EQ(selected.size(), 1);
    EXPECT_EQ(selected[0][1].toInt(), 1);

    const QRectF chosen(505000, 5945000, 12000, 8000);
    map->SetViewRect(chosen);
    const QRectF shown = map->ViewRect();
    page.reset();
    page = open();
    EXPECT_NEAR(page->Map()->ViewRect().center().x(), shown.center().x(), 1e-6);
    EXPECT_NEAR(page->Map()->ViewRect().width(), shown.width(), 1e-6);
}

TEST(MapPage, AMeshThatCannotBeReadIsSaidOnTheMap) {
    CSetupDocument doc;
    doc.GetDomain()->MeshFile("missing.2dm");
    uitest::CRecordingHost host;
    CMeshNavigationDlg page;
    page.Attach(doc.GetDomain(), &host);
    page.Initialize();
    EXPECT_FALSE(page.Map()->Mesh());
    EXPECT_EQ(page.BoundaryOverlay(), -1);
}

} // namespace
