// The editor's costs that a user feels, offscreen: recording a stored change for undo, taking
// it back, and showing the form of a selected node (create, fill, lay out). Prints a table;
// times are wall-clock medians of repeated runs.
#include "EditorWindow.h"
#include "PreferencesDialog.h"
#include "SetupHistory.h"
#include "core/MudTransportModuleKiv.h"
#include "core/ParameterSelectionKiv.h"
#include "fem/BoundaryNamesKiv.h"
#include "fem/SimulationPeriodKiv.h"
#include "hydro/HDSourcesKiv.h"
#include "setupeditor/NavigationTree.h"

#include <QApplication>
#include <QLayout>
#include <QUndoStack>

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <string>
#include <vector>

namespace {

using Clock = std::chrono::steady_clock;

double Ms(Clock::duration d) { return std::chrono::duration<double, std::milli>(d).count(); }

double Median(std::vector<double> v) {
    std::sort(v.begin(), v.end());
    return v.empty() ? 0.0 : v[v.size() / 2];
}

// 8 fractions, 12 layers, n boundaries and n sources.
std::string LargeSetup(int n) {
    CSetupDocument doc;
    CParameterSelectionKiv* model = ModelDefinition(doc.Module());
    model->NumberOfFractions(8);
    model->NumberOfLayers(12);
    doc.GetBoundaryNames()->SetItemCount(n, 1);
    doc.GetSources()->SetItemCount(n, 1);
    for (int i = 1; i <= n; ++i) {
        doc.GetBoundaryNames()->GetItem(i)->Identifier("Boundary " + std::to_string(i));
        doc.GetSources()->GetItem(i)->Name("Source " + std::to_string(i));
    }
    return doc.ToText();
}

struct Times {
    std::vector<double> record, undo, redo;
};

void PrintRow(const char* setup, const char* edit, size_t bytes, const Times& t) {
    auto worst = [](const std::vector<double>& v) { return v.empty() ? 0.0 : *std::max_element(v.begin(), v.end()); };
    std::printf("| %s | %s | %zu | %.2f | %.2f | %.2f | %.2f | %.2f | %.2f |\n", setup, edit, bytes,
                Median(t.record), worst(t.record), Median(t.undo), worst(t.undo), Median(t.redo), worst(t.redo));
}

template <class Edit>
Times Measure(CEditorWindow& window, int runs, Edit edit) {
    Times t;
    for (int i = 0; i < runs; ++i) {
        edit(i);
        auto t0 = Clock::now();
        window.UpdateDoc(window.CurrentDialog(), 1);
        t.record.push_back(Ms(Clock::now() - t0));
    }
    for (int i = 0; i < runs; ++i) {
        auto t0 = Clock::now();
        window.Undo();
        t.undo.push_back(Ms(Clock::now() - t0));
    }
    for (int i = 0; i < runs; ++i) {
        auto t0 = Clock::now();
        window.Redo();
        t.redo.push_back(Ms(Clock::now() - t0));
    }
    return t;
}

// Stored changes as a form makes them (a value, and the number of fractions, which changes
// every per-fraction list), recorded for undo, then undone and redone; the history's memory
// after 100 value edits.
void MeasureUndo(CEditorWindow& window, const char* name) {
    const size_t bytes = window.Document().ToText().size();
    window.SelectPath("SIMULATION_PERIOD");
    CSimulationPeriodKiv* period = window.Document().GetPeriod();
    PrintRow(name, "value", bytes, Measure(window, 30, [&](int i) { period->TimeStepCount(1000 + i); }));
    window.SelectPath("MUD_TRANSPORT_MODULE/MODEL_DEFINITION");
    CParameterSelectionKiv* model = ModelDefinition(window.Document().Module());
    PrintRow(name, "fractions", bytes, Measure(window, 4, [&](int i) { model->NumberOfFractions(i % 2 ? 8 : 7); }));
    window.SelectPath("SIMULATION_PERIOD");
    for (int i = 0; i < 100; ++i) {
        period->TimeStepCount(5000 + i);
        window.UpdateDoc(window.CurrentDialog(), 1);
    }
    std::printf("| %s | history after 100 value edits: %.3f MB, %d steps |  |  |  |  |  |  |  |\n", name,
                window.History().MemoryBytes() / 1048576.0, window.UndoStack()->count());
}

void MeasureForms(CEditorWindow& window) {
    constexpr int kRuns = 7;
    struct Row {
        std::string path;
        double ms;
    };
    std::vector<Row> rows;
    const std::vector<CZoSEKivBase*> nodes = window.ShownNodes();
    CZoSEKivBase* other = nodes.front();
    for (CZoSEKivBase* node : nodes) {
        std::vector<double> runs;
        for (int i = 0; i < kRuns; ++i) {
            window.SelectTreeItem(node == other ? nodes.back() : other);
            QApplication::processEvents();
            auto t0 = Clock::now();
            window.SelectTreeItem(node);
            // Layout happens on the posted request; count it as part of showing.
            QCoreApplication::sendPostedEvents(nullptr, QEvent::LayoutRequest);
            if (QWidget* form = window.CurrentDialog())
                if (QLayout* layout = form->layout())
                    layout->activate();
            runs.push_back(Ms(Clock::now() - t0));
        }
        rows.push_back({NodePath(node), Median(runs)});
    }
    std::vector<double> all;
    for (const Row& r : rows)
        all.push_back(r.ms);
    const auto worst = std::max_element(rows.begin(), rows.end(), [](const Row& a, const Row& b) { return a.ms < b.ms; });
    std::printf("\nForms of the example: %zu nodes, median %.2f ms, worst %.2f ms (%s)\n", rows.size(),
                Median(all), worst->ms, worst->path.c_str());
    std::sort(rows.begin(), rows.end(), [](const Row& a, const Row& b) { return a.ms > b.ms; });
    std::printf("\n| slowest nodes | ms |\n|---|---|\n");
    for (size_t i = 0; i < std::min<size_t>(5, rows.size()); ++i)
        std::printf("| %s | %.2f |\n", rows[i].path.c_str(), rows[i].ms);
}

}  // namespace

int main(int argc, char** argv) {
    if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM"))
        qputenv("QT_QPA_PLATFORM", "offscreen");
    QApplication app(argc, argv);
    const QString example = QStringLiteral(MUD_SOURCE_DIR "/examples/estuary.setup");

    std::printf("| setup | edit | text bytes | record ms | worst | undo ms | worst | redo ms | worst |\n");
    std::printf("|---|---|---|---|---|---|---|---|---|\n");
    {
        CEditorWindow window;
        window.show();
        if (!window.OpenFile(example)) {
            std::fprintf(stderr, "editor_bench: cannot open %s\n", qPrintable(example));
            return 1;
        }
        MeasureUndo(window, "examples/estuary.setup");
    }
    for (int n : {1000, 10000}) {
        const std::string path = "/tmp/editor_bench_" + std::to_string(n) + ".setup";
        if (FILE* f = std::fopen(path.c_str(), "w")) {
            const std::string text = LargeSetup(n);
            std::fwrite(text.data(), 1, text.size(), f);
            std::fclose(f);
        }
        CEditorWindow window;
        window.show();
        if (!window.OpenFile(QString::fromStdString(path)))
            return 1;
        const std::string name = "8 fractions, 12 layers, " + std::to_string(n) + " boundaries and sources";
        MeasureUndo(window, name.c_str());
        std::remove(path.c_str());
    }

    CEditorWindow window;
    window.show();
    window.OpenFile(example);
    MeasureForms(window);
    return 0;
}
