// Outputs: a change of the number of fractions rebuilds the quantity selections of every
// output (1,000 outputs of 8 fractions and 12 layers), and an output of many points loads,
// validates and saves in time linear in its points.
#include "core/MudTransportModuleKiv.h"
#include "core/ParameterSelectionKiv.h"
#include "fem/DomainKiv.h"
#include "host/SetupDocument.h"
#include "outputs/MTOutputKiv.h"

#include <benchmark/benchmark.h>

#include <string>

namespace {

CMTOutputKiv* Outputs(CSetupDocument& doc) {
    return GetImportant<CMTOutputKiv>(doc.Module(), "MTOutputs");
}

void FractionChange(benchmark::State& state) {
    CSetupDocument doc;
    CParameterSelectionKiv* model = ModelDefinition(doc.Module());
    model->NumberOfFractions(8);
    model->NumberOfLayers(12);
    Outputs(doc)->SetItemCount(static_cast<int>(state.range(0)), 1);
    int fractions = 8;
    for (auto _ : state) {
        fractions = fractions == 8 ? 7 : 8;
        model->NumberOfFractions(fractions);
    }
    state.SetItemsProcessed(state.iterations() * state.range(0));
}

// One point-series output of n points in a three-dimensional domain with a mesh.
std::string PointsText(int n) {
    CSetupDocument doc;
    CDomainKiv* domain = doc.GetDomain();
    domain->MeshFile("bench.2dm");
    domain->SetMeshInfo({0, 1000, 0, 1000, -10, 0});
    domain->ThreeD(true);
    CMTOutputItemMainKiv* o = Outputs(doc)->Append();
    o->FileName("points.qrd0");
    o->InterpolationType(1);
    o->Points().clear();
    for (int i = 0; i < n; ++i)
        o->Points().push_back({i * 0.01, 1000.0 - i * 0.01, -1.0, 1 + i % 10, "P" + std::to_string(i + 1)});
    return doc.ToText();
}

void PointsLoad(benchmark::State& state) {
    const std::string text = PointsText(static_cast<int>(state.range(0)));
    for (auto _ : state) {
        auto opened = CSetupDocument::FromText(text, "bench.setup");
        benchmark::DoNotOptimize(opened.document.get());
    }
    state.SetItemsProcessed(state.iterations() * state.range(0));
}

void PointsValidate(benchmark::State& state) {
    auto opened = CSetupDocument::FromText(PointsText(static_cast<int>(state.range(0))), "bench.setup");
    for (auto _ : state)
        benchmark::DoNotOptimize(opened.document->ValidateAll());
    state.SetItemsProcessed(state.iterations() * state.range(0));
}

void PointsSave(benchmark::State& state) {
    auto opened = CSetupDocument::FromText(PointsText(static_cast<int>(state.range(0))), "bench.setup");
    for (auto _ : state) {
        std::string text = opened.document->ToText();
        benchmark::DoNotOptimize(text.data());
    }
    state.SetItemsProcessed(state.iterations() * state.range(0));
}

BENCHMARK(FractionChange)->Arg(100)->Arg(1000)->Unit(benchmark::kMillisecond);
BENCHMARK(PointsLoad)->RangeMultiplier(10)->Range(1000, 100000)->Unit(benchmark::kMillisecond);
BENCHMARK(PointsValidate)->RangeMultiplier(10)->Range(1000, 100000)->Unit(benchmark::kMillisecond);
BENCHMARK(PointsSave)->RangeMultiplier(10)->Range(1000, 100000)->Unit(benchmark::kMillisecond);

}  // namespace

BENCHMARK_MAIN();
