// Find as you type, and importing a whole list's CSV, on the generated lists.
#include <benchmark/benchmark.h>
#include <unistd.h>

#include <filesystem>
#include <fstream>

#include "bench/bench_world.h"
#include "catalogue/list_import.h"
#include "catalogue/records.h"
#include "export/list_report.h"
#include "main_window/title_finder.h"

namespace bench {
namespace {

// One keystroke that finds the last title: the whole list is searched, then the entry fields are
// filled as a click fills them.
void BM_FindKeystroke(benchmark::State& state) {
    World& w = World::get(static_cast<int>(state.range(0)));
    w.form->LoadEntries(w.list);
    main_window::TitleFinder finder(*w.form);
    const std::string last(w.view.List1.itemText(w.view.List1.count() - 1));
    for (auto _ : state) finder.Text_find_Change(last);
    if (w.view.Text1.text() != last) state.SkipWithError("the last title was not found");
}

// The list's own CSV imported into a new list. A list numbers at most 999 titles per letter, so
// rows of letters already used up are refused, as Add refuses them.
void BM_Import(benchmark::State& state) {
    World& w = World::get(static_cast<int>(state.range(0)));
    const std::string csv = exporting::listCsv(w.store, w.list);
    const std::string index = w.list + "\r\n";  // as the world was made
    const std::string list = "Imported";
    catalogue::ImportResult result;
    for (auto _ : state) {
        state.PauseTiming();
        for (const std::string& file : {catalogue::entryFile(list), catalogue::articleFile(list),
                                        catalogue::counterFile(list), catalogue::flagFile(list)}) {
            std::filesystem::remove(w.store.path(file));
        }
        std::ofstream out(w.store.path("pemla.dat"), std::ios::binary | std::ios::trunc);
        out << index;
        out.close();
        // The removals above go to disk now, not in the import's first flush.
        ::sync();
        state.ResumeTiming();
        result = catalogue::importCsv(w.store, list, csv);
    }
    if (!result.problem.empty() || result.added == 0) state.SkipWithError("nothing imported");
    state.counters["added"] = result.added;
}

BENCHMARK(BM_FindKeystroke)->Arg(1000)->Arg(32767)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_Import)->Arg(1000)->Arg(32767)->Unit(benchmark::kMillisecond);

}  // namespace
}  // namespace bench
