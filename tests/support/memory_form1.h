#pragma once

#include <memory>

#include "catalogue/store.h"
#include "main_window/form1.h"
#include "tests/support/memory/memory_controls.h"
#include "tests/support/temp_folder.h"

namespace test_support {

// The main window's controls in memory, each owned by the window so that a disabled window
// refuses input.
struct MemoryForm1 {
    MemoryForm1();
    main_window::Form1Controls controls();

    ui::memory::MemoryWindow window;
    ui::memory::MemoryLabel Label1;
    ui::memory::MemoryListBox List_list;
    ui::memory::MemoryButton Command_create;
    ui::memory::MemoryButton Command_delete;
    ui::memory::MemoryLabel Label2;
    ui::memory::MemoryListBox List1;
    ui::memory::MemoryButton Command_search;
    ui::memory::MemoryButton Command_delentry;
    ui::memory::MemoryButton Command_export;
    ui::memory::MemoryButton Command_print;
    ui::memory::MemoryLabel Label4;
    ui::memory::MemoryTextBox Text1;
    ui::memory::MemoryComboBox Combo1;
    ui::memory::MemoryComboBox Combo2;
    ui::memory::MemoryComboBox Combo3;
    ui::memory::MemoryLabel Label3;
    ui::memory::MemoryTextBox Textart;
    ui::memory::MemoryButton Command_add;
    ui::memory::MemoryButton Command_change;
    ui::memory::MemoryButton Command_clear;
};

// A catalogue folder with the supplied suggestion files and an index, and the main window on it.
// Call start() after putting the files a test needs.
struct MainWindowFixture {
    MainWindowFixture();
    // Writes a list's files: entry text, article text, counter text, and the flag (none when
    // `flag` is empty).
    void putList(const std::string& name, const std::string& entries, const std::string& articles,
                 const std::string& counter = "A#001\r\n", const std::string& flag = " 1 \r\n");
    // Loads the main window (its start-up runs).
    void start();
    // Opens a list as the user does, by selecting it in the list of lists.
    void open(const std::string& list);

    TempFolder folder;
    catalogue::Store store;
    ui::memory::MemoryPlatform platform;
    MemoryForm1 view;
    std::unique_ptr<main_window::Form1> form;
};

}  // namespace test_support
