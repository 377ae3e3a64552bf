// Loading, saving and validating a whole setup, for growing numbers of list items: the time
// per item must stay flat (no step may scan a list for every item).
#include "core/MudTransportModuleKiv.h"
#include "core/ParameterSelectionKiv.h"
#include "fem/BoundaryNamesKiv.h"
#include "host/SetupDocument.h"
#include "hydro/HDSourcesKiv.h"

#include <benchmark/benchmark.h>

#include <string>
#include <string_view>

namespace {

// A setup of 8 fractions and 12 layers with n boundaries and n sources.
std::string SetupText(int n) {
    CSetupDocument doc;
    CParameterSelectionKiv* model = ModelDefinition(doc.Module());
    model->NumberOfFractions(8);
    model->NumberOfLayers(12);
    CBoundaryNamesKiv* boundaries = doc.GetBoundaryNames();
    CHDSourcesKiv* sources = doc.GetSources();
    boundaries->SetItemCount(n, 1);
    sources->SetItemCount(n, 1);
    for (int i = 1; i <= n; ++i) {
        boundaries->GetItem(i)->Identifier("Boundary " + std::to_string(i));
        sources->GetItem(i)->Name("Source " + std::to_string(i));
        sources->GetItem(i)->X(1000.0 + i);
    }
    return doc.ToText();
}

void Load(benchmark::State& state) {
    const std::string text = SetupText(static_cast<int>(state.range(0)));
    for (auto _ : state) {
        auto opened = CSetupDocument::FromText(text, "bench.setup");
        benchmark::DoNotOptimize(opened.document.get());
    }
    state.SetItemsProcessed(state.iterations() * state.range(0));
    state.SetBytesProcessed(state.iterations() * static_cast<int64_t>(text.size()));
}

// As Load, with a keyword no node reads in every source: reporting what was not read must
// stay linear too.
void LoadWithUnknownKeywords(benchmark::State& state) {
    const std::string plain = SetupText(static_cast<int>(state.range(0)));
    std::string text;
    text.reserve(plain.size() + plain.size() / 4);
    const std::string_view opening = "    SOURCE_";
    for (std::size_t at = 0; at < plain.size();) {
        const std::size_t end = plain.find('\n', at) + 1;
        const std::string_view line(plain.data() + at, end - at);
        text.append(line);
        if (line.substr(0, opening.size()) == opening)
            text.append("        unknown_keyword = 1\n");
        at = end;
    }
    std::size_t warnings = 0;
    for (auto _ : state) {
        auto opened = CSetupDocument::FromText(text, "bench.setup");
        warnings = opened.warnings.size();
        benchmark::DoNotOptimize(opened.document.get());
    }
    if (warnings != static_cast<std::size_t>(state.range(0)))
        state.SkipWithError("every unknown keyword must be reported once");
    state.SetItemsProcessed(state.iterations() * state.range(0));
    state.SetBytesProcessed(state.iterations() * static_cast<int64_t>(text.size()));
}

void Save(benchmark::State& state) {
    auto opened = CSetupDocument::FromText(SetupText(static_cast<int>(state.range(0))), "bench.setup");
    for (auto _ : state) {
        std::string text = opened.document->ToText();
        benchmark::DoNotOptimize(text.data());
    }
    state.SetItemsProcessed(state.iterations() * state.range(0));
}

void Validate(benchmark::State& state) {
    auto opened = CSetupDocument::FromText(SetupText(static_cast<int>(state.range(0))), "bench.setup");
    for (auto _ : state)
        benchmark::DoNotOptimize(opened.document->ValidateAll());
    state.SetItemsProcessed(state.iterations() * state.range(0));
}

BENCHMARK(Load)->RangeMultiplier(10)->Range(100, 100000)->Unit(benchmark::kMillisecond);
BENCHMARK(LoadWithUnknownKeywords)->RangeMultiplier(10)->Range(100, 100000)->Unit(benchmark::kMillisecond);
BENCHMARK(Save)->RangeMultiplier(10)->Range(100, 100000)->Unit(benchmark::kMillisecond);
BENCHMARK(Validate)->RangeMultiplier(10)->Range(100, 100000)->Unit(benchmark::kMillisecond);

}  // namespace

BENCHMARK_MAIN();
