#include "bench/bench_world.h"

#include <stdlib.h>

#include <filesystem>
#include <fstream>
#include <sstream>

#include "bench/catalogue_maker.h"

namespace bench {

namespace {

std::string makeFolder() {
    std::string pattern = (std::filesystem::temp_directory_path() / "pemla-bench-XXXXXX").string();
    if (::mkdtemp(pattern.data()) == nullptr) throw std::runtime_error("mkdtemp failed");
    return pattern;
}

std::map<int, std::unique_ptr<World>>& worlds() {
    static std::map<int, std::unique_ptr<World>> all;
    return all;
}

}  // namespace

World::World(int entries) : folder(makeFolder()), store(folder) {
    writeCatalogue(folder, list);
    writeList(folder, list, entries);
    for (const char* ext : {".dat", ".art", ".arn"}) {
        original[list + ext] = store.readBytes(list + ext);
    }
    form = std::make_unique<main_window::Form1>(view.controls(), platform, store);
    view.window.show();
    view.List_list.userSelect(list);
}

World::~World() {
    std::error_code ec;
    std::filesystem::remove_all(folder, ec);
}

World& World::get(int entries) {
    auto& slot = worlds()[entries];
    if (!slot) slot = std::make_unique<World>(entries);
    return *slot;
}

void World::clear() {
    worlds().clear();
}

void World::restore() {
    for (const auto& [name, bytes] : original) {
        std::ofstream out(store.path(name), std::ios::binary | std::ios::trunc);
        out << bytes;
    }
    form->LoadEntries(list);
}

}  // namespace bench
