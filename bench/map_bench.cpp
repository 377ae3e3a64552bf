// Frame times of the map on a mesh of a million elements, at full extent and zoomed in,
// each frame after a pan so that no frame merely repeats the one before.
#include "MeshGenerator.h"
#include "mesh/MeshReader.h"
#include "widgets/ZoMapView.h"

#include <QApplication>
#include <QImage>
#include <QPainter>

#include <benchmark/benchmark.h>

namespace {

MeshPtr Mesh() {
    static const MeshPtr mesh = Read2dm(GridMesh2dm(1000000), "bench.2dm").mesh;
    return mesh;
}

// zoom: the share of the mesh's width in view.
void Frame(benchmark::State& state, double zoom) {
    CZoMapView view;
    view.resize(1200, 800);
    view.SetMesh(Mesh());
    view.FitToMesh();
    const MeshExtent& e = Mesh()->Extent();
    const double w = (e.xMax - e.xMin) * zoom;
    view.SetViewRect(QRectF(e.xMin + (e.xMax - e.xMin) * 0.4, e.yMin + (e.yMax - e.yMin) * 0.4, w, w * 2 / 3));
    const int overlay = view.AddOverlay("Points", Qt::red);
    for (int i = 0; i < 50; ++i)
        view.AddPoint(overlay, i + 1, QString("P%1").arg(i), e.xMin + i * 100, e.yMin + i * 100, "UTM-32");
    QImage image(view.size(), QImage::Format_ARGB32_Premultiplied);
    {
        QPainter warm(&image);
        view.Render(warm);  // the image of the whole mesh is drawn once, on first need
    }
    int step = 0;
    for (auto _ : state) {
        view.PanBy(QPointF((step++ % 2) ? 3 : -3, 0));
        QPainter p(&image);
        view.Render(p);
    }
    const char* modes[] = {"none", "overview", "raster", "elements"};
    state.SetLabel(modes[static_cast<int>(view.LastMeshDraw())]);
}

void FullExtent(benchmark::State& s) { Frame(s, 1.0); }
void QuarterWidth(benchmark::State& s) { Frame(s, 0.25); }
void CloseZoom(benchmark::State& s) { Frame(s, 0.02); }
BENCHMARK(FullExtent)->Unit(benchmark::kMillisecond);
BENCHMARK(QuarterWidth)->Unit(benchmark::kMillisecond);
BENCHMARK(CloseZoom)->Unit(benchmark::kMillisecond);

void FirstFrameOnANewMesh(benchmark::State& state) {
    for (auto _ : state) {
        CZoMapView view;
        view.resize(1200, 800);
        view.SetMesh(Mesh());
        view.FitToMesh();
        QImage image(view.size(), QImage::Format_ARGB32_Premultiplied);
        QPainter p(&image);
        view.Render(p);
    }
}
BENCHMARK(FirstFrameOnANewMesh)->Unit(benchmark::kMillisecond)->Iterations(3);

}  // namespace

int main(int argc, char** argv) {
    if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM"))
        qputenv("QT_QPA_PLATFORM", "offscreen");
    QApplication app(argc, argv);
    benchmark::Initialize(&argc, argv);
    benchmark::RunSpecifiedBenchmarks();
    benchmark::Shutdown();
    return 0;
}
