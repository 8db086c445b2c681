#include "main_window/form1.h"

#include <filesystem>

#include "catalogue/catalogue_error.h"
#include "catalogue/entry_rules.h"
#include "catalogue/file_names.h"

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

void Form1::Form_Load() {
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
        std::error_code ec;
        const std::string folder =
            std::filesystem::absolute(store_.folder(), ec).lexically_normal();
        platform_.messageBox("Pemla cannot start: the file \"" +
                                 catalogue::shownName(error.file()) + "\" in the folder \"" +
                                 catalogue::shownName(folder) + "\" cannot be used (" +
                                 error.reason() + ").",
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
    c_.List_list.setItems(store_.readLines(catalogue::kIndexFile));
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

void Form1::guarded(const std::function<void()>& body) {
    try {
        body();
    } catch (const CatalogueError& error) {
        showError(error.file(), error.reason());
    } catch (const Refusal& refusal) {
        platform_.messageBox(refusal.prompt, ui::kCritical, "Error");
    }
}

void Form1::showError(const std::string& file, const std::string& reason) {
    platform_.messageBox(
        "The file \"" + catalogue::shownName(file) + "\" could not be used:\r\n" + reason + ".",
        ui::kCritical, "Error");
}

}  // namespace main_window
