#pragma once

#include <functional>
#include <string>

#include "catalogue/store.h"
#include "ui/controls.h"
#include "ui/platform.h"

// The main window: the lists, the open list's titles, the entry fields and their buttons.
namespace main_window {

struct Form1Controls {
    ui::Window& window;
    ui::Label& Label1;
    ui::ListBox& List_list;
    ui::Button& Command_create;
    ui::Button& Command_delete;
    ui::Label& Label2;
    ui::ListBox& List1;
    ui::Button& Command_search;
    ui::Button& Command_delentry;
    ui::Button& Command_export;
    ui::Button& Command_print;
    ui::Label& Label4;
    ui::TextBox& Text1;
    ui::ComboBox& Combo1;
    ui::ComboBox& Combo2;
    ui::ComboBox& Combo3;
    ui::Label& Label3;
    ui::TextBox& Textart;
    ui::Button& Command_add;
    ui::Button& Command_change;
    ui::Button& Command_clear;
};

// The dialogs the main window opens; any may be missing.
struct Form1Dialogs {
    ui::Window* newList = nullptr;
    ui::Window* exporter = nullptr;
    ui::Window* search = nullptr;
};

inline constexpr const char* kForm1Caption = "Pemla 0.90Beta";
inline constexpr const char* kNoAmount = "... amount ...";
// One space, "Title", 62 spaces, "Type", 41 spaces, "CD's", 13 spaces, "Information".
extern const std::string kColumnHeader;

class Form1 {
public:
    // Sets the captions and initial texts and wires every event to its handler.
    Form1(const Form1Controls& controls, ui::Platform& platform, catalogue::Store& store);

    void setDialogs(const Form1Dialogs& dialogs) { dialogs_ = dialogs; }
    const Form1Controls& controls() const { return c_; }
    ui::Platform& platform() { return platform_; }
    catalogue::Store& store() { return store_; }

    // Start-up: finishes an interrupted save, fills the suggestion boxes and the lists. On a
    // failure it says which file is missing in which folder and ends the program with status 1.
    void Form_Load();
    // Closing the window unloads the export dialog, then the new-list dialog (and the search).
    void Form_Unload();

    // Refills List_list from the list index and empties List1. Throws CatalogueError.
    void LoadListNames();

    void Command_create_Click();
    void Command_export_Click();
    void Command_search_Click();
    void Command_print_Click();

    // The selected list's name, or an empty text when none is selected.
    std::string selectedList() const;

    // Runs a handler body; a catalogue failure is shown as a message naming the file and the
    // reason, and the window stays usable.
    void guarded(const std::function<void()>& body);
    // Shows a catalogue failure the way every handler does.
    void showError(const std::string& file, const std::string& reason);

    // State of the open list.
    std::string ListText;
    int EntryCount = 0;
    std::string ArticleNumber;

private:
    void fillSuggestions(const std::string& file, ui::ComboBox& box);

    Form1Controls c_;
    ui::Platform& platform_;
    catalogue::Store& store_;
    Form1Dialogs dialogs_;
};

}  // namespace main_window
