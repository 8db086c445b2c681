#include "main_window/form1.h"

#include <filesystem>

#include "catalogue/catalogue_error.h"
#include "catalogue/entry_rules.h"
#include "catalogue/file_names.h"
#include "catalogue/file_text.h"

namespace main_window {

using catalogue::CatalogueError;

const std::string kColumnHeader = " Title" + std::string(62, ' ') + "Type" + std::string(41, ' ') +
                                  "CD's" + std::string(13, ' ') + "Information";

Form1::Form1(const Form1Controls& controls, ui::Platform& platform, catalogue::Store& store)
    : c_(controls), platform_(platform), store_(store) {
    c_.window.setCaption(kForm1Caption);
    c_.Label1.setCaption("Current lists");
    c_.Command_create.setCaption("Create new list");
    c_.Command_delete.setCaption("Delete list");
    c_.Label2.setCaption(kNoAmount);
    c_.Command_search.setCaption("Search Art#");
    c_.Command_delentry.setCaption("Delete entry");
    c_.Command_export.setCaption("Export pemla");
    c_.Command_print.setCaption("Exit");
    c_.Label4.setCaption(kColumnHeader);
    c_.Text1.setMaxLength(26);
    c_.Combo1.setText("Select type");
    c_.Combo2.setText("Disc(s)");
    std::vector<std::string> discs;
    for (int i = 1; i <= 10; ++i) discs.push_back(std::to_string(i));
    c_.Combo2.setItems(discs);
    c_.Combo3.setText("Info");
    c_.Label3.setCaption("Art #");
    c_.Command_add.setCaption("Add");
    c_.Command_change.setCaption("Change");
    c_.Command_clear.setCaption("Reset");

    c_.window.onLoad = [this] { Form_Load(); };
    c_.window.onUnload = [this] { Form_Unload(); };
    c_.Command_create.onClick = [this] { Command_create_Click(); };
    c_.Command_export.onClick = [this] { Command_export_Click(); };
    c_.Command_search.onClick = [this] { Command_search_Click(); };
    c_.Command_print.onClick = [this] { Command_print_Click(); };
    c_.List_list.onClick = [this] { List_list_Click(); };
    c_.List1.onClick = [this] { List1_Click(); };
    c_.Command_clear.onClick = [this] { Command_clear_Click(); };
    c_.Combo1.onKeyPress = [this](int& key) { Combo1_KeyPress(key); };
    c_.Combo2.onKeyPress = [this](int& key) { Combo2_KeyPress(key); };
    c_.Combo3.onKeyPress = [this](int& key) { Combo3_KeyPress(key); };
    c_.Command_add.onClick = [this] { Command_add_Click(); };
    c_.Command_change.onClick = [this] { Command_change_Click(); };
    c_.Command_delentry.onClick = [this] { Command_delentry_Click(); };
    c_.Command_delete.onClick = [this] { Command_delete_Click(); };
}

namespace {

std::string absoluteFolder(const std::string& folder) {
    std::error_code ec;
    const std::filesystem::path full = std::filesystem::absolute(folder, ec);
    return ec ? folder : full.lexically_normal().string();
}

}  // namespace

void Form1::Form_Load() {
    // Taken before anything is read or finished: a second copy must not touch a journal or a
    // staged file of the copy that holds the folder.
    lock_.reset();  // a window loaded again takes the lock again, not a second one beside it
    lock_ = std::make_unique<catalogue::FolderLock>(store_.folder());
    if (lock_->state() == catalogue::FolderLock::State::Taken) {
        platform_.messageBox("Pemla is already running on the folder \"" +
                                 catalogue::shownName(absoluteFolder(store_.folder())) +
                                 "\". Use the window that is open there: a second copy could "
                                 "undo its changes, so this one ends without changing anything.",
                             ui::kCritical, "Error");
        platform_.endProgram(3);
        return;
    }
    try {
        store_.recover();
        fillSuggestions("type.dat", c_.Combo1);
        fillSuggestions("information.dat", c_.Combo3);
        // Lists saved by earlier builds carry Latin-1 file names; they move to today's names
        // together. Should that fail, the start goes on and each such list says so when opened.
        const std::vector<std::string> lists = store_.readLines(catalogue::kIndexFile);
        guarded([&] { catalogue::renameLegacyListFiles(store_, lists); });
        LoadListNames();
        return;
    } catch (const CatalogueError& error) {
        platform_.messageBox("Pemla cannot start: the file \"" +
                                 catalogue::shownName(error.file()) + "\" in the folder \"" +
                                 catalogue::shownName(absoluteFolder(store_.folder())) +
                                 "\" cannot be used (" + error.reason() + ").",
                             ui::kCritical, "Error");
    }
    platform_.endProgram(1);
}

void Form1::fillSuggestions(const std::string& file, ui::ComboBox& box) {
    std::vector<std::string> lines = store_.readLines(file);
    if (lines.empty()) throw CatalogueError(file, "the file is empty");
    lines.erase(lines.begin());  // the heading line is never offered
    box.setItems(std::move(lines));
}

void Form1::Form_Unload() {
    for (ui::Window* dialog : {dialogs_.exporter, dialogs_.newList, dialogs_.search}) {
        if (dialog != nullptr && dialog->isLoaded()) dialog->unload();
    }
}

void Form1::LoadListNames() {
    wholeList_.clear();
    c_.List_list.clear();
    c_.List1.clear();
    const std::string index = store_.readBytes(catalogue::kIndexFile, &indexStamp_);
    std::vector<std::string> names;
    for (std::string_view line : catalogue::splitLines(index)) names.emplace_back(line);
    c_.List_list.setItems(std::move(names));
}

void Form1::Command_create_Click() {
    if (dialogs_.newList != nullptr) dialogs_.newList->show();
}

void Form1::Command_export_Click() {
    if (c_.List1.count() == 0) {
        platform_.beep();
        return;
    }
    if (dialogs_.exporter != nullptr) dialogs_.exporter->show();
}

void Form1::Command_search_Click() {
    for (int i = 0; i < c_.List_list.count(); ++i) {
        if (c_.List_list.selected(i)) {
            if (dialogs_.search != nullptr) dialogs_.search->show();
            return;
        }
    }
    platform_.beep();
}

void Form1::Command_print_Click() {
    platform_.endProgram(0);
}

std::string Form1::selectedList() const {
    std::string name;
    for (int i = 0; i < c_.List_list.count(); ++i) {
        if (c_.List_list.selected(i)) name = c_.List_list.itemText(i);
    }
    return name;
}

namespace {

std::string errorText(const std::string& file, const std::string& reason) {
    return "The file \"" + catalogue::shownName(file) + "\" could not be used:\r\n" + reason + ".";
}

}  // namespace

void Form1::guarded(const std::function<void()>& body, bool busy) {
    std::string prompt;
    bool stale = false;
    {
        std::optional<ui::BusyPointer> pointer;
        if (busy) pointer.emplace(platform_);
        try {
            body();
        } catch (const catalogue::ChangedOnDisk& error) {
            prompt = error.file() == catalogue::kJournalName
                         ? std::string(
                               "An earlier change that was left unfinished has now been "
                               "completed, so nothing else was done.")
                         : "The file \"" + catalogue::shownName(error.file()) +
                               "\" was changed on disk after this window read it, so nothing "
                               "was written.";
            prompt +=
                "\r\nThe window now shows the files as they are; please make the change "
                "again.";
            stale = true;
        } catch (const catalogue::UnfinishedChange& error) {
            prompt = errorText(error.file(), error.reason()) +
                     "\r\nThe window now shows the files as they are.";
            stale = true;
        } catch (const CatalogueError& error) {
            prompt = errorText(error.file(), error.reason());
        } catch (const Refusal& refusal) {
            prompt = refusal.prompt;
        }
    }
    if (stale) showFilesAgain();
    if (!prompt.empty()) platform_.messageBox(prompt, ui::kCritical, "Error");
}

void Form1::showFilesAgain() {
    const std::string list = selectedList();
    const std::optional<std::string> title = selectedTitle();
    const std::string information = c_.Combo3.text();
    store_.trySettle();
    guarded([&] {
        LoadListNames();
        for (int i = 0; i < c_.List_list.count(); ++i) {
            if (c_.List_list.itemText(i) != list) continue;
            c_.List_list.setSelected(i, true);
            LoadEntries(list);
            for (int j = 0; title && j < c_.List1.count(); ++j) {
                if (c_.List1.itemText(j) == *title) c_.List1.setSelected(j, true);
            }
        }
    });
    c_.Combo3.setText(information);
}

void Form1::showError(const std::string& file, const std::string& reason) {
    platform_.messageBox(errorText(file, reason), ui::kCritical, "Error");
}

}  // namespace main_window
