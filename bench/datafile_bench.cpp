// The data-file check reads only the header: a 1 GB file must be answered in about the
// time of a 1 kB one. The large file is sparse (its values are never read), made when the
// benchmark starts and removed at the end.
#include "datafile/DataFile.h"
#include "datafile/DataFileCache.h"
#include "datafile/ZoFileSelector.h"

#include <benchmark/benchmark.h>


#include <cstdio>
#include <filesystem>
#include <string>

namespace {

namespace fs = std::filesystem;

const char* const kHeader =
    "qrd0 1\n"
    "start 2024-01-01 00:00:00\n"
    "step 1\n"
    "steps 100000000\n"
    "items 4\n"
    "item x 100183\n"
    "item y 100183\n"
    "item rate 100195\n"
    "item spill 100013\n"
    "values\n";

// A file of the header followed by size bytes in all.
std::string MakeFile(const char* name, std::uintmax_t size) {
    const fs::path p = fs::temp_directory_path() / name;
    std::FILE* f = std::fopen(p.c_str(), "wb");
    std::fputs(kHeader, f);
    std::fclose(f);
    fs::resize_file(p, size);
    return p.string();
}

const std::string& Small() {
    static const std::string p = MakeFile("mudsetup-bench-1kB.qrd0", 1024);
    return p;
}
const std::string& Large() {
    static const std::string p = MakeFile("mudsetup-bench-1GB.qrd0", std::uintmax_t{1} << 30);
    return p;
}

CZoFileSelector Requests() {
    CZoFileSelector s;
    s.SetMinNoItems(4);
    s.AddRequest("x-coordinate").SetOvuType(100183);
    s.AddRequest("y-coordinate").SetOvuType(100183);
    s.AddRequest("rate of dredged mass").SetMultiOvuType({100195, 100504});
    s.AddRequest("spill").SetMultiOvuType({100013, 100505});
    s.SetTimeValidation(0, 1000, 1.0);
    return s;
}

// The first check of a file: the header is read from disk every time.
void CheckUncached(benchmark::State& state, const std::string& path) {
    const CZoFileSelector s = Requests();
    for (auto _ : state) {
        datafile::ClearHeaderCache();
        benchmark::DoNotOptimize(s.IsQrdFileValid(path, {1, 2, 3, 4}, nullptr));
    }
}

// Later checks of an unchanged file: a look at its size and time only.
void CheckCached(benchmark::State& state, const std::string& path) {
    const CZoFileSelector s = Requests();
    for (auto _ : state)
        benchmark::DoNotOptimize(s.IsQrdFileValid(path, {1, 2, 3, 4}, nullptr));
}

void Check1kB(benchmark::State& state) { CheckUncached(state, Small()); }
void Check1GB(benchmark::State& state) { CheckUncached(state, Large()); }
void CheckCached1kB(benchmark::State& state) { CheckCached(state, Small()); }
void CheckCached1GB(benchmark::State& state) { CheckCached(state, Large()); }

BENCHMARK(Check1kB)->Unit(benchmark::kMicrosecond);
BENCHMARK(Check1GB)->Unit(benchmark::kMicrosecond);
BENCHMARK(CheckCached1kB)->Unit(benchmark::kMicrosecond);
BENCHMARK(CheckCached1GB)->Unit(benchmark::kMicrosecond);

}  // namespace

int main(int argc, char** argv) {
    benchmark::Initialize(&argc, argv);
    benchmark::RunSpecifiedBenchmarks();
    benchmark::Shutdown();
    std::remove(Small().c_str());
    std::remove(Large().c_str());
    return 0;
}
