// Times creating a list and exporting the largest lists, each against its own floor.
#include <benchmark/benchmark.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

#include <filesystem>
#include <fstream>

#include "bench/bench_world.h"
#include "catalogue/store.h"
#include "export/form_export.h"
#include "new_list/form_new_list.h"
#include "tests/support/memory_dialogs.h"

namespace bench {
namespace {

using test_support::MemoryNewList;

void BM_CreateList(benchmark::State& state) {
    World& w = World::get(static_cast<int>(state.range(0)));
    MemoryNewList d;
    new_list::Form_new_list dialog(d.controls(), w.platform, w.store, *w.form);
    const std::string index = w.store.readBytes("pemla.dat");
    for (auto _ : state) {
        d.window.show();
        d.Text1.setText("Benchmark list");
        d.Command1.click();
        state.PauseTiming();
        for (const char* ext : {".dat", ".art", ".arn", ".inf"}) {
            std::filesystem::remove(w.store.path(std::string("Benchmark list") + ext));
        }
        std::ofstream(w.store.path("pemla.dat"), std::ios::binary | std::ios::trunc) << index;
        w.view.List_list.userSelect(w.list);
        state.ResumeTiming();
    }
}

using MemoryExport = test_support::MemoryFormExport;

// Arguments: entries, article layout, information column, HTML.
void BM_Export(benchmark::State& state) {
    World& w = World::get(static_cast<int>(state.range(0)));
    const std::string out = w.folder + "/reports";
    std::filesystem::create_directories(out);
    std::ofstream(w.store.path(w.list + ".inf"), std::ios::binary | std::ios::trunc)
        << (state.range(2) ? " 1 \r\n" : " 0 \r\n");
    MemoryExport d;
    exporting::Form_Export dialog(d.controls(), w.platform, w.store, *w.form);
    d.Dir1.setPath(out);
    d.Checkart.setValue(static_cast<int>(state.range(1)));
    d.Checkhtml.setValue(static_cast<int>(state.range(3)));
    d.Checkcounter.setValue(1);
    d.Checkdate.setValue(1);
    d.Checkline.setValue(1);
    d.Combo1.addItem("Top");
    d.Combo1.addItem("Bottom");
    d.Combo1.setText("Bottom");
    d.Text2.setText("99");
    const std::size_t boxes = w.platform.shown().size();
    for (auto _ : state) {
        d.Check_lastadd.setValue(1);
        w.platform.answer(ui::Answer::Ok);  // "Export done!"
        dialog.RunExport();
    }
    if (w.platform.shown().size() - boxes != static_cast<std::size_t>(state.iterations()) ||
        w.platform.shown().back().prompt != "Export done!") {
        state.SkipWithError("the export did not finish");
    }
    std::ofstream(w.store.path(w.list + ".inf"), std::ios::binary | std::ios::trunc) << " 1 \r\n";
}

// The export's floor: reading the entry and article files and writing a report of the same size
// once, atomically.
void BM_ExportFloor(benchmark::State& state) {
    World& w = World::get(static_cast<int>(state.range(0)));
    const std::string out = w.folder + "/reports/floor.TXT";
    std::filesystem::create_directories(w.folder + "/reports");
    for (auto _ : state) {
        std::string bytes = w.store.readBytes(w.list + ".dat");
        bytes += w.store.readBytes(w.list + ".art");
        catalogue::writeFileAtomically(out, bytes);
    }
}

}  // namespace

long exportPeakKilobytes() {
    int pipeEnds[2];
    if (::pipe(pipeEnds) != 0) return -1;
    const pid_t child = ::fork();
    if (child == 0) {
        // A fresh process: its peak is the program's own state plus one export of the largest
        // list with every option that adds text.
        World w(32767);
        MemoryExport d;
        exporting::Form_Export dialog(d.controls(), w.platform, w.store, *w.form);
        const std::string out = w.folder + "/reports";
        std::filesystem::create_directories(out);
        d.Dir1.setPath(out);
        for (auto* box :
             {&d.Checkart, &d.Checkcounter, &d.Checkdate, &d.Checkline, &d.Check_lastadd}) {
            box->setValue(1);
        }
        d.Combo1.addItem("Top");
        d.Combo1.setText("Top");
        d.Text2.setText("99");
        w.platform.answer(ui::Answer::Ok);
        dialog.RunExport();
        struct rusage usage {};
        ::getrusage(RUSAGE_SELF, &usage);
        const long peak = w.platform.shown().back().prompt == "Export done!" ? usage.ru_maxrss : -1;
        [[maybe_unused]] const auto wrote = ::write(pipeEnds[1], &peak, sizeof peak);
        // _exit() runs no destructor: the world's folder is removed here, or every run leaves
        // a generated catalogue behind in the temporary folder.
        std::error_code ec;
        std::filesystem::remove_all(w.folder, ec);
        ::_exit(0);
    }
    ::close(pipeEnds[1]);
    long peak = -1;
    if (::read(pipeEnds[0], &peak, sizeof peak) != sizeof peak) peak = -1;
    ::close(pipeEnds[0]);
    ::waitpid(child, nullptr, 0);
    return peak;
}

namespace {

BENCHMARK(BM_CreateList)->Arg(1000)->Arg(32767)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_ExportFloor)->Arg(1000)->Arg(32767)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_Export)
    ->ArgNames({"entries", "art", "info", "html"})
    ->ArgsProduct({{1000, 32767}, {0, 1}, {0, 1}, {0}})
    ->Args({32767, 1, 1, 1})
    ->Unit(benchmark::kMillisecond);

}  // namespace
}  // namespace bench
