#pragma once

#include <map>
#include <memory>
#include <string>

#include "catalogue/store.h"
#include "main_window/form1.h"
#include "tests/support/memory_form1.h"

namespace bench {

// A catalogue folder holding one generated list, and the main window on memory controls over it.
struct World {
    explicit World(int entries);
    ~World();

    // The world for a list size, made on first use.
    static World& get(int entries);
    static void clear();

    // Puts the list's files back as generated and opens the list again.
    void restore();

    std::string folder;
    std::string list = "Collection";
    catalogue::Store store;
    ui::memory::MemoryPlatform platform;
    test_support::MemoryForm1 view;
    std::unique_ptr<main_window::Form1> form;
    std::map<std::string, std::string> original;
};

}  // namespace bench
