#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <string>

#include "catalogue/folder_lock.h"
#include "catalogue/list_edits.h"
#include "catalogue/records.h"
#include "catalogue/store.h"
#include "main_window/main_window_link.h"
#include "ui/controls.h"
#include "ui/platform.h"

// The main window: the lists, the open list's titles, the entry fields and their buttons.
namespace main_window {

struct Form1Controls {
    ui::Window& window;            // the main window
    ui::Label& Label1;             // "Current lists" caption
    ui::ListBox& List_list;        // the list names
    ui::Button& Command_create;    // Create new list
    ui::Button& Command_delete;    // Delete list
    ui::Label& Label2;             // amount of titles
    ui::ListBox& List1;            // the open list's titles
    ui::Button& Command_search;    // Search Art#
    ui::Button& Command_delentry;  // Delete entry
    ui::Button& Command_export;    // Export pemla
    ui::Button& Command_print;     // Exit
    ui::Label& Label4;             // column header above the titles
    ui::TextBox& Text1;            // title
    ui::ComboBox& Combo1;          // type
    ui::ComboBox& Combo2;          // discs
    ui::ComboBox& Combo3;          // information
    ui::Label& Label3;             // "Art #" caption
    ui::TextBox& Textart;          // article number (read-only)
    ui::Button& Command_add;       // Add
    ui::Button& Command_change;    // Change
    ui::Button& Command_clear;     // Reset
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

class Form1 : public MainWindowLink {
  public:
    // Sets the captions and initial texts and wires every event to its handler.
    Form1(const Form1Controls& controls, ui::Platform& platform, catalogue::Store& store);

    void setDialogs(const Form1Dialogs& dialogs) { dialogs_ = dialogs; }
    const Form1Controls& controls() const { return c_; }
    ui::Platform& platform() { return platform_; }
    catalogue::Store& store() { return store_; }

    // Start-up: locks the folder, finishes an interrupted save, fills the suggestion boxes and
    // the lists. On a failure it says which file cannot be used in which folder and ends the
    // program with status 1; when another copy holds the folder it says so, naming the folder,
    // and ends with status 3. Either way nothing is written.
    void Form_Load();
    // Closing the window unloads the export dialog, then the new-list dialog (and the search).
    void Form_Unload();

    // Refills List_list from the list index and empties List1. Throws CatalogueError.
    void LoadListNames() override;

    void Command_create_Click();
    void Command_export_Click();
    void Command_search_Click();
    void Command_print_Click();

    // Opening a list: List_list's click loads the selected list.
    void List_list_Click();
    // Reads a list's entry and flag files into ListText, EntryCount, List1 and Label2, and sets
    // up the title length and the information box. Throws CatalogueError; the list is then
    // shown empty and its entry file is not written until it loads whole.
    void LoadEntries(const std::string& name);

    // Selecting an entry fills the entry fields and its article number.
    void List1_Click();
    void ResetEntryFields();
    void Command_clear_Click() { ResetEntryFields(); }
    void Combo1_KeyPress(int& key) { limitTyping(c_.Combo1, 17, key); }
    void Combo2_KeyPress(int& key) { limitTyping(c_.Combo2, 6, key); }
    void Combo3_KeyPress(int& key) { limitTyping(c_.Combo3, 16, key); }

    void Command_add_Click();
    void Command_change_Click();
    void Command_delentry_Click();
    void Command_delete_Click();

    // Whether a list has the information column: lists made by older copies may have no flag
    // file, and they have it. Throws CatalogueError when the flag file cannot be read.
    bool HasInformation(const std::string& list);

    // The selected list's name, or an empty text when none is selected.
    std::string selectedList() const override;
    const ui::ListBox& titles() const override { return c_.List1; }
    void setEnabled(bool enabled) override { c_.window.setEnabled(enabled); }
    void bringToFront() override { c_.window.bringToFront(); }

    using Refusal = main_window::Refusal;

    // Runs a handler body, with the busy pointer when asked; a catalogue failure is shown as a
    // message naming the file and the reason, a Refusal as its prompt, and the window stays
    // usable. When the files on disk are no longer the ones the window shows (changed behind its
    // back, or a change left unfinished), the window shows them again as they are now. The busy
    // pointer is off before any message shows.
    void guarded(const std::function<void()>& body, bool busy = false) override;
    // Shows a catalogue failure the way every handler does.
    void showError(const std::string& file, const std::string& reason) override;

    // State of the open list.
    std::string ListText;
    int EntryCount = 0;
    std::string ArticleNumber;

  private:
    void fillSuggestions(const std::string& file, ui::ComboBox& box);
    void limitTyping(ui::ComboBox& box, std::size_t limit, int& key);
    // The fields as an entry, refused when a value could not be stored safely.
    catalogue::Entry fieldsAsEntry() const;
    // The open list as the changes to `list` are computed from it.
    catalogue::OpenList openList(const std::string& list, int titles) const;
    // The selected row of List1, or nothing.
    std::optional<std::string> selectedTitle() const;
    // Reads the lists and the open list again, keeping the selections and the typed fields.
    void showFilesAgain();
    // Every change starts here: a change left unfinished is finished first, and when that moved
    // files the window shows is refused (ChangedOnDisk naming the journal) and shows them again.
    void finishEarlierChange() { catalogue::finishEarlierChange(store_); }

    // The list whose entry file ListText holds whole; empty after a failed or no load.
    std::string wholeList_;
    // The entry file and the index as they were read, for the writes computed from them.
    catalogue::FileStamp listStamp_, indexStamp_;
    std::unique_ptr<catalogue::FolderLock> lock_;

    Form1Controls c_;
    ui::Platform& platform_;
    catalogue::Store& store_;
    Form1Dialogs dialogs_;
};

}  // namespace main_window
