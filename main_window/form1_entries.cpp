// Opening a list and showing its entries in the main window.
#include "catalogue/catalogue_error.h"
#include "catalogue/file_text.h"
#include "catalogue/records.h"
#include "main_window/form1.h"

namespace main_window {

using catalogue::CatalogueError;

void Form1::List_list_Click() {
    c_.List1.clear();
    ResetEntryFields();
    // A change left half-done is finished before the list is read, where that can be done now;
    // otherwise the list shows its files as they are, and writes are refused until it is.
    store_.trySettle();
    for (int i = 0; i < c_.List_list.count(); ++i) {
        if (c_.List_list.selected(i)) {
            const std::string name(c_.List_list.itemText(i));
            guarded([&] { LoadEntries(name); }, true);
        }
    }
}

bool Form1::HasInformation(const std::string& list) {
    const std::string flagFile = catalogue::flagFile(list);
    return !store_.exists(flagFile) || store_.readNumber(flagFile) == 1;
}

void Form1::LoadEntries(const std::string& name) {
    ListText.clear();
    EntryCount = 0;
    wholeList_.clear();
    c_.List1.clear();
    c_.Label2.setCaption(kNoAmount);

    const std::string entryFile = catalogue::entryFile(name);
    std::string bytes = store_.readBytes(entryFile, &listStamp_);

    const bool information = HasInformation(name);
    c_.Text1.setMaxLength(information ? 26 : 42);
    c_.Combo3.setEnabled(information);
    c_.Combo3.setText(information ? "Info" : "  ");

    std::optional<list_order::Items> titles = catalogue::entryTitles(bytes);
    if (!titles) {
        throw CatalogueError(entryFile, "the file ends inside an entry (" +
                                            std::to_string(catalogue::splitLines(bytes).size()) +
                                            " lines, which is not four lines per entry)");
    }
    ListText = catalogue::toFileText(std::move(bytes));
    EntryCount = static_cast<int>(titles->size());
    c_.List1.setItems(std::move(*titles));
    c_.Label2.setCaption("... amount: " + catalogue::labelNumber(EntryCount) + " ...");
    wholeList_ = name;
}

void Form1::ShowEditedEntries(const std::string& name, catalogue::EditResult& result) {
    if (wholeList_ != name || (!result.removedTitle && !result.addedTitle)) {
        LoadEntries(name);
        return;
    }
    // List1 holds this list's titles as last shown, so moving the one title keeps it equal to
    // a refill from the file just written; loading leaves no title selected either.
    if (const int row = c_.List1.selectedIndex(); row >= 0) c_.List1.setSelected(row, false);
    if (result.removedTitle && !c_.List1.removeItem(*result.removedTitle)) {
        LoadEntries(name);
        return;
    }
    if (result.addedTitle) c_.List1.addItem(*result.addedTitle);
    ListText = std::move(result.entries);
    listStamp_ = result.stamp;
    EntryCount = c_.List1.count();
    c_.Label2.setCaption("... amount: " + catalogue::labelNumber(EntryCount) + " ...");
}

void Form1::List1_Click() {
    guarded(
        [&] {
            c_.List_list.refresh();
            const std::optional<std::string> title = selectedTitle();
            if (!title) return;
            c_.Text1.setText(*title);
            if (const auto entry = catalogue::findEntry(ListText, *title)) {
                c_.Combo1.setText(entry->type);
                c_.Combo2.setText(entry->discs);
                c_.Combo3.setText(entry->information);
            }
            const std::string list = selectedList();
            if (list.empty()) return;
            c_.Textart.setText("");
            const std::string articles = store_.readText(catalogue::articleFile(list));
            c_.Textart.setText(
                catalogue::findArticleNumber(articles, c_.Text1.text()).value_or(""));
        },
        true);
}

void Form1::ResetEntryFields() {
    c_.Text1.setText("");
    c_.Combo1.setText("Select type");
    c_.Combo2.setText("Disc(s)");
    c_.Combo3.setText("Info");
    c_.Textart.setText("");
    if (const int row = c_.List1.selectedIndex(); row >= 0) c_.List1.setSelected(row, false);
}

void Form1::limitTyping(ui::ComboBox& box, std::size_t limit, int& key) {
    // Judged by the text after the key: a key typed over a selection replaces it.
    if (key != 8 && box.text().size() - box.selectedLength() >= limit) key = 0;
}

std::optional<std::string> Form1::selectedTitle() const {
    const int row = c_.List1.selectedIndex();
    if (row < 0) return std::nullopt;
    return std::string(c_.List1.itemText(row));
}

}  // namespace main_window
