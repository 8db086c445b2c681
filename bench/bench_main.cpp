// Times the main window's operations on generated lists against the floor: reading the list's
// files and writing them once through the same atomic path. Prints one table.
#include <benchmark/benchmark.h>
#include <stdlib.h>

#include <QApplication>
#include <QListView>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <map>
#include <memory>
#include <optional>
#include <sstream>

#include "app/main_window_view.h"
#include "bench/bench_world.h"
#include "catalogue/store.h"
#include "main_window/form1.h"
#include "ui/qt/qt_platform.h"

namespace bench {

long exportPeakKilobytes();
// Peak memory of the largest export must stay below this.
constexpr double kPeakTargetMegabytes = 40;

namespace {

void BM_Floor(benchmark::State& state) {
    World& w = World::get(static_cast<int>(state.range(0)));
    for (auto _ : state) {
        catalogue::Transaction t = w.store.begin();
        for (const char* ext : {".dat", ".art", ".arn"}) {
            const std::string name = w.list + ext;
            t.write(name, w.store.readBytes(name));
        }
        t.commit();
    }
}

void BM_Open(benchmark::State& state) {
    World& w = World::get(static_cast<int>(state.range(0)));
    for (auto _ : state) w.form->LoadEntries(w.list);
}

void BM_OpenQt(benchmark::State& state) {
    World& w = World::get(static_cast<int>(state.range(0)));
    catalogue::Store store(w.folder);
    ui::qt::QtPlatform platform;
    app::MainWindowView view;
    main_window::Form1 form(view.controls(), platform, store);
    for (auto _ : state) {
        form.LoadEntries(w.list);
        QApplication::processEvents();  // the list box lays out and paints its first rows
    }
    if (view.List1->model()->rowCount() != static_cast<int>(state.range(0)))
        state.SkipWithError("not filled");
}

void BM_Select(benchmark::State& state) {
    World& w = World::get(static_cast<int>(state.range(0)));
    w.form->LoadEntries(w.list);
    int row = 0;
    for (auto _ : state) {
        row = (row + 7919) % w.view.List1.count();
        w.view.List1.userSelect(row);
    }
}

void BM_Add(benchmark::State& state) {
    World& w = World::get(static_cast<int>(state.range(0)));
    const std::size_t boxesBefore = w.platform.shown().size();
    for (auto _ : state) {
        state.PauseTiming();
        w.restore();
        w.view.Text1.setText("Benchmark title");
        state.ResumeTiming();
        w.view.Command_add.click();
    }
    if (w.platform.shown().size() != boxesBefore) state.SkipWithError("a message box was shown");
}

void change(benchmark::State& state, const char* newTitle) {
    World& w = World::get(static_cast<int>(state.range(0)));
    const std::size_t boxesBefore = w.platform.shown().size();
    for (auto _ : state) {
        state.PauseTiming();
        w.restore();
        w.view.List1.userSelect(w.view.List1.count() / 2);
        w.view.Text1.setText(newTitle);
        w.platform.answer(ui::Answer::Yes);
        state.ResumeTiming();
        w.view.Command_change.click();
    }
    if (w.platform.shown().size() - boxesBefore != static_cast<std::size_t>(state.iterations())) {
        state.SkipWithError("unexpected message box");
    }
}

void BM_ChangeSameLetter(benchmark::State& state) {
    change(state, "Moon Changed");
}
void BM_ChangeNewLetter(benchmark::State& state) {
    change(state, "Benchmark changed");
}

void BM_Delete(benchmark::State& state) {
    World& w = World::get(static_cast<int>(state.range(0)));
    for (auto _ : state) {
        state.PauseTiming();
        w.restore();
        w.view.List1.userSelect(w.view.List1.count() / 3);
        w.platform.answer(ui::Answer::Yes);
        state.ResumeTiming();
        w.view.Command_delentry.click();
    }
}

constexpr int kSmall = 1000;
constexpr int kLarge = 32767;

BENCHMARK(BM_Floor)->Arg(kSmall)->Arg(kLarge)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_Open)->Arg(kSmall)->Arg(kLarge)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_OpenQt)->Arg(kSmall)->Arg(kLarge)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_Select)->Arg(kSmall)->Arg(kLarge)->Unit(benchmark::kMillisecond);
// A full list refuses another title, so adding is measured on a list one short of full.
BENCHMARK(BM_Add)->Arg(kSmall)->Arg(kLarge - 1)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_ChangeSameLetter)->Arg(kSmall)->Arg(kLarge)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_ChangeNewLetter)->Arg(kSmall)->Arg(kLarge)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_Delete)->Arg(kSmall)->Arg(kLarge)->Unit(benchmark::kMillisecond);

// Collects every result and prints one table with each row's ratio to the floor of its size.
class TableReporter : public benchmark::BenchmarkReporter {
  public:
    bool ReportContext(const Context&) override { return true; }
    void ReportRuns(const std::vector<Run>& runs) override {
        for (const Run& run : runs) {
            if (run.error_occurred) {
                std::printf("%s: %s\n", run.benchmark_name().c_str(), run.error_message.c_str());
                continue;
            }
            rows_.push_back(
                {run.run_name.function_name, run.run_name.args, run.GetAdjustedRealTime()});
        }
    }
    void Finalize() override {
        // Exports are held against reading their input and writing their output; the rest
        // against reading and writing the list's own files.
        std::map<std::pair<std::string, int>, double> floor;
        for (const Row& row : rows_) {
            if (row.name == "BM_Floor" || row.name == "BM_ExportFloor") {
                floor[{row.name, size(row.args)}] = row.ms;
            }
        }
        std::printf(
            "| operation | entries | time (ms) | x floor | target | met |\n"
            "|---|---|---:|---:|---|---|\n");
        for (const Row& row : rows_) {
            const int entries = size(row.args);
            const std::string base =
                row.name.starts_with("BM_Export") ? "BM_ExportFloor" : "BM_Floor";
            auto found = floor.find({base, entries});
            if (found == floor.end()) found = floor.find({base, entries + 1});
            const double ratio = found == floor.end() ? 0.0 : row.ms / found->second;
            std::string target, met;
            if (const std::optional<Target> t = targetOf(row.name, entries)) {
                const double value = t->milliseconds ? row.ms : ratio;
                target = "<= " + number(t->limit) + (t->milliseconds ? " ms" : "x");
                met = value > 0 && value <= t->limit ? "yes" : "no";
            }
            std::printf("| %s | %s | %.2f | %.2f | %s | %s |\n", row.name.substr(3).c_str(),
                        row.args.c_str(), row.ms, ratio, target.c_str(), met.c_str());
        }
    }

    // What the largest lists are held to: a ratio to the floor, or a time a user must not feel.
    struct Target {
        double limit;
        bool milliseconds;
    };
    static std::optional<Target> targetOf(const std::string& name, int entries) {
        if (entries < kLarge - 1) return std::nullopt;
        if (name == "BM_Add" || name.starts_with("BM_Change") || name == "BM_Delete") {
            return Target{1.5, false};
        }
        if (name == "BM_OpenQt") return Target{2, false};
        if (name == "BM_Export" || name == "BM_Import") return Target{3, false};
        if (name == "BM_FindKeystroke") return Target{16, true};
        return std::nullopt;
    }

  private:
    static std::string number(double value) {
        char text[16];
        std::snprintf(text, sizeof text, "%g", value);
        return text;
    }

    struct Row {
        std::string name;
        std::string args;
        double ms;
    };
    // The list size: the first number among the arguments.
    static int size(const std::string& args) {
        const std::size_t digit = args.find_first_of("0123456789");
        return digit == std::string::npos ? 0 : std::atoi(args.c_str() + digit);
    }
    std::vector<Row> rows_;
};

}  // namespace
}  // namespace bench

int main(int argc, char** argv) {
    setenv("QT_QPA_PLATFORM", "offscreen", 0);
    QApplication application(argc, argv);
    benchmark::Initialize(&argc, argv);
    const long peak = bench::exportPeakKilobytes();
    bench::TableReporter table;
    benchmark::RunSpecifiedBenchmarks(&table);
    const double peakMegabytes = peak / 1024.0;
    std::printf(
        "\nPeak memory of a process exporting 32,767 entries: %.1f MB (target <= %g MB: %s)\n",
        peakMegabytes, bench::kPeakTargetMegabytes,
        peak > 0 && peakMegabytes <= bench::kPeakTargetMegabytes ? "met" : "not met");
    benchmark::Shutdown();
    bench::World::clear();
    return 0;
}
