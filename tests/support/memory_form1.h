#pragma once

#include <memory>
#include <string>
#include <vector>

#include "catalogue/store.h"
#include "main_window/form1.h"
#include "tests/support/faulty_sys.h"
#include "tests/support/memory_dialogs.h"
#include "tests/support/temp_folder.h"

namespace test_support {

// The main window's controls in memory, each owned by the window so that a disabled window
// refuses input.
struct MemoryForm1 {
    MemoryForm1() {
        ui::memory::own(window, List_list, Command_create, Command_delete, List1, Command_search,
                        Command_delentry, Command_export, Command_print, Text1, Combo1, Combo2,
                        Combo3, Textart, Command_add, Command_change, Command_clear);
    }
    main_window::Form1Controls controls() {
        return {window,        Label1, List_list,      Command_create,   Command_delete,
                Label2,        List1,  Command_search, Command_delentry, Command_export,
                Command_print, Label4, Text1,          Combo1,           Combo2,
                Combo3,        Label3, Textart,        Command_add,      Command_change,
                Command_clear};
    }

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

// A catalogue folder with the supplied suggestion files and an empty index, an output folder,
// and the main window with its new-list and export dialogs on it, every system call going
// through `sys`. Call start() after putting the files a test needs.
struct MainWindowFixture {
    MainWindowFixture();

    // Loads the main window (its start-up runs).
    void start() { view.window.show(); }
    // The user selects a list, or a title of the open list; false (and a failure) when it is
    // not shown.
    bool open(const std::string& list) { return pick(view.List_list, list); }
    bool select(const std::string& title) { return pick(view.List1, title); }
    bool pick(ui::memory::MemoryListBox& box, const std::string& item);
    // The user clears the entry fields and types these values; or clears one box and types.
    void fill(const catalogue::Entry& entry);
    template <typename Box>
    static void retype(Box& box, const std::string& text) {
        box.type(std::string(box.text().size(), '\b') + text);
    }
    // The user presses the button, the message boxes it shows answered in this order.
    void press(ui::memory::MemoryButton& button, const std::vector<ui::Answer>& answers = {}) {
        for (ui::Answer answer : answers) platform.answer(answer);
        button.click();
    }
    // The user adds "Dylan" (Game, 1) with this information to the open list, or deletes the
    // selected list confirming twice; an error box, should one come, is answered.
    void addDylan(const std::string& information = "x");
    void deleteList();
    // The user opens the new-list dialog, types the name and presses "Create".
    void createList(const std::string& name);

    // The catalogue folder's files, and the output folder's under "out/", whose path in them
    // reads "<out>".
    Files files() const;
    // The message boxes titled "Error" shown so far.
    std::vector<ui::memory::MemoryPlatform::Shown> errors() const;
    // Exactly one message box was shown since `before` boxes, with this style, title and prompt
    // (any prompt when none is given).
    void expectBox(std::size_t before, int style, const std::string& title,
                   const std::string& prompt = {}) const;

    TempFolder folder, out;
    FaultySys sys;
    catalogue::Store store;
    ui::memory::MemoryPlatform platform;
    MemoryForm1 view;
    std::unique_ptr<main_window::Form1> form;
    MemoryNewList newListView;
    new_list::Form_new_list newList;
    MemoryFormExport exportView;
    exporting::Form_Export exporter;
};

}  // namespace test_support
