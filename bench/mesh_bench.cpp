// Reading a .2dm mesh and indexing it, for growing sizes: the time per element must stay
// flat up to a million elements.
#include "MeshGenerator.h"
#include "mesh/MeshIndex.h"
#include "mesh/MeshReader.h"

#include <benchmark/benchmark.h>

namespace {

void Read2dmText(benchmark::State& state) {
    const std::string text = GridMesh2dm(state.range(0));
    size_t elements = 0;
    for (auto _ : state) {
        const MeshReadResult r = Read2dm(text, "bench.2dm");
        if (!r.mesh)
            state.SkipWithError(r.error.c_str());
        else
            elements = r.mesh->ElementCount();
        benchmark::DoNotOptimize(r.mesh.get());
    }
    state.SetItemsProcessed(state.iterations() * static_cast<int64_t>(elements));
    state.SetBytesProcessed(state.iterations() * static_cast<int64_t>(text.size()));
}
BENCHMARK(Read2dmText)->Arg(10000)->Arg(100000)->Arg(1000000)->Unit(benchmark::kMillisecond);

void BuildIndex(benchmark::State& state) {
    const MeshReadResult r = Read2dm(GridMesh2dm(state.range(0)), "bench.2dm");
    for (auto _ : state) {
        const CMeshIndex index(*r.mesh);
        benchmark::DoNotOptimize(&index);
    }
    state.SetItemsProcessed(state.iterations() * static_cast<int64_t>(r.mesh->ElementCount()));
}
BENCHMARK(BuildIndex)->Arg(10000)->Arg(1000000)->Unit(benchmark::kMillisecond);

}  // namespace

BENCHMARK_MAIN();
