// Reader and writer throughput on a large generated setup, and the memory a document holds.
#include "paramfile/ParamFile.h"
#include "paramfile/ParamFileImpl.h"

#include <benchmark/benchmark.h>

#include <charconv>
#include <random>
#include <string>
#include <vector>

using namespace paramfile;

namespace {

constexpr int kKeywords = 1000000;

// Appends rather than "literal" + std::string, on which g++ 12 -O3 warns falsely.
template <class... Parts> std::string Join(const Parts&... parts) {
    std::string s;
    ((s += parts), ...);
    return s;
}

class Generator {
public:
    explicit Generator(Builder& b) : b_(b) {
        const char* words[] = {"settling", "velocity",   "critical",      "shear",   "stress",
                               "erosion",  "deposition", "fraction",      "density", "porosity",
                               "layer",    "thickness",  "coefficient",   "power",   "flocculation",
                               "hindered", "salinity",   "concentration", "bed",     "roughness",
                               "time",     "step",       "output",        "file",    "number",
                               "of",       "type",       "format",        "max",     "min"};
        for (int i = 0; i < 300; ++i) {
            std::string name = words[Pick(0, 29)];
            for (int n = Pick(0, 2); n > 0; --n)
                (name += '_') += words[Pick(0, 29)];
            names_.push_back(name);
        }
    }

    void Run() {
        for (int top = 1; keywords_ < kKeywords; ++top)
            Section(1, Pick(3, 5), Join("MODULE_", std::to_string(top % 40)));
    }

private:
    int Pick(int lo, int hi) { return std::uniform_int_distribution<int>(lo, hi)(rng_); }

    double Decimal() {
        // Up to 17 significant digits, the way a model writes its settings.
        const int digits = Pick(0, 3) == 0 ? Pick(12, 17) : Pick(1, 6);
        std::string s = std::to_string(Pick(1, 9));
        for (int i = 1; i < digits; ++i)
            s += char('0' + Pick(0, 9));
        (s += 'e') += std::to_string(Pick(-9, 5) - digits);
        double d = 0;
        std::from_chars(s.data(), s.data() + s.size(), d);
        return Pick(0, 4) == 0 ? -d : d;
    }

    void Keyword() {
        b_.AddKeyword(names_[Pick(0, int(names_.size()) - 1)]);
        ++keywords_;
        const int kind = Pick(0, 99);
        if (kind < 30) {
            b_.AddInt(Pick(0, 3) == 0 ? Pick(-100000, 1000000) : Pick(0, 100));
        } else if (kind < 60) {
            b_.AddDouble(Decimal());
        } else if (kind < 75) {
            for (int n = Pick(2, 5); n > 0; --n) {
                if (Pick(0, 1))
                    b_.AddInt(Pick(0, 5000));
                else
                    b_.AddDouble(Pick(0, 100000) / 1000.0);
            }
        } else if (kind < 85) {
            std::string s = names_[Pick(0, 299)];
            s[0] = static_cast<char>(s[0] - 'a' + 'A');
            if (Pick(0, 9) == 0)
                s += " \"quoted\"\tpart";
            b_.AddString(s);
        } else if (kind < 93) {
            // Picked one by one: argument order would differ between compilers.
            const char* dir = Pick(0, 1) ? "C:\\Projects\\estuary\\run_" : "../results/run_";
            const std::string run = std::to_string(Pick(1, 99));
            b_.AddFileName(Join(dir, run, "/", names_[Pick(0, 299)], ".qrdu"));
        } else {
            b_.AddBool(Pick(0, 1));
        }
    }

    void Section(int depth, int maxDepth, const std::string& name) {
        b_.BeginSection(name);
        for (int n = Pick(3, 12); n > 0; --n)
            Keyword();
        if (depth < maxDepth) {
            for (int n = Pick(1, 3); n > 0; --n)
                Section(depth + 1, maxDepth,
                        depth % 2 ? Join("FRACTION_", std::to_string(n)) : "LAYER");
        }
        b_.EndSection();
    }

    Builder& b_;
    std::mt19937 rng_{20240607};
    std::vector<std::string> names_;
    int keywords_ = 0;
};

const std::string& Text() {
    static const std::string text = [] {
        Document doc;
        Builder b(doc);
        Generator(b).Run();
        return WriteText(doc);
    }();
    return text;
}

void ReportMemory(benchmark::State& state, const Document& doc) {
    const double held = static_cast<double>(doc.impl().MemoryBytes());
    const double file = static_cast<double>(Text().size());
    state.counters["file_MB"] = file / 1e6;
    state.counters["doc_MB"] = held / 1e6;
    state.counters["doc_per_file"] = held / file;
}

void BM_ParseText(benchmark::State& state) {
    const std::string& text = Text();
    ParseResult last;
    for (auto _ : state) {
        state.PauseTiming();
        std::string copy = text;
        last = ParseResult();
        state.ResumeTiming();
        last = ParseText(std::move(copy), "bench.par");
        benchmark::DoNotOptimize(last.document.get());
    }
    if (last.error) {
        state.SkipWithError(last.error->ToString().c_str());
        return;
    }
    state.SetBytesProcessed(static_cast<std::int64_t>(state.iterations() * text.size()));
    ReportMemory(state, *last.document);
}

void BM_WriteText(benchmark::State& state) {
    ParseResult r = ParseText(Text(), "bench.par");
    std::string out;
    for (auto _ : state) {
        WriteText(*r.document, out);
        benchmark::DoNotOptimize(out.data());
    }
    if (out != Text())
        state.SkipWithError("writer output differs from its input");
    state.SetBytesProcessed(static_cast<std::int64_t>(state.iterations() * out.size()));
}

} // namespace

BENCHMARK(BM_ParseText)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_WriteText)->Unit(benchmark::kMillisecond);
BENCHMARK_MAIN();
