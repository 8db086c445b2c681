// Adding, changing and deleting entries, and deleting lists: the window confirms, the catalogue
// makes the change as one transaction, and the window shows the outcome.
#include "catalogue/entry_rules.h"
#include "main_window/form1.h"

namespace main_window {

namespace {

// A refused change is shown as every refusal is.
void requireDone(const catalogue::EditResult& result) {
    if (!result) throw Refusal{result.refusal};
}

}  // namespace

catalogue::Entry Form1::fieldsAsEntry() const {
    catalogue::Entry entry{c_.Text1.text(), c_.Combo1.text(), c_.Combo2.text(), c_.Combo3.text()};
    if (std::string refusal = catalogue::entryRefusal(entry); !refusal.empty()) {
        throw Refusal{std::move(refusal)};
    }
    return entry;
}

catalogue::OpenList Form1::openList(const std::string& list, int titles) const {
    return {list, ListText, listStamp_, wholeList_ == list, titles};
}

void Form1::Command_add_Click() {
    guarded([&] {
        finishEarlierChange();
        const std::string list = selectedList();
        if (list.empty()) {
            // Nothing to store the entry in: the fields keep what was typed for when a list is
            // open.
            throw Refusal{
                "No list is open, so the title was not added. Select the list to add it "
                "to, then press Add again."};
        }
        const catalogue::Entry entry{c_.Text1.text(), c_.Combo1.text(), c_.Combo2.text(),
                                     c_.Combo3.text()};
        catalogue::EditResult result =
            catalogue::addEntry(store_, openList(list, EntryCount), entry);
        requireDone(result);
        ArticleNumber = std::move(result.articleNumber);
        ListText = std::move(result.entries);
        LoadEntries(list);
        ResetEntryFields();
    });
    c_.Text1.setFocus();
}

void Form1::Command_change_Click() {
    const std::optional<std::string> oldTitle = selectedTitle();
    if (!oldTitle) {
        platform_.messageBox("Select the entry to change in the list first.", ui::kCritical,
                             "Error");
        return;
    }
    guarded([&] {
        finishEarlierChange();
        // A value the files cannot hold is refused before the user is asked.
        const catalogue::Entry entry = fieldsAsEntry();
        if (platform_.messageBox("Are ya sure yo want to change selected entry?", ui::kYesNo,
                                 "Change item") != ui::Answer::Yes) {
            ResetEntryFields();
            return;
        }
        const std::string list = selectedList();
        if (list.empty()) {
            ResetEntryFields();
            return;
        }
        catalogue::EditResult result =
            catalogue::changeEntry(store_, openList(list, EntryCount), *oldTitle, entry);
        requireDone(result);
        if (!result.articleNumber.empty()) ArticleNumber = std::move(result.articleNumber);
        ListText = std::move(result.entries);
        LoadEntries(list);
        ResetEntryFields();
    });
}

void Form1::Command_delentry_Click() {
    const std::optional<std::string> title = selectedTitle();
    if (!title) return;
    if (platform_.messageBox("Are ya sure yo want to DELETE selected entry?",
                             ui::kYesNo | ui::kSecondDefault, "Change item") != ui::Answer::Yes) {
        return;
    }
    const std::string list = selectedList();
    if (list.empty()) {
        ResetEntryFields();
        return;
    }
    guarded([&] {
        finishEarlierChange();
        catalogue::EditResult result =
            catalogue::deleteEntry(store_, openList(list, c_.List1.count()), *title);
        requireDone(result);
        if (result.emptied) {
            LoadEntries(list);
            ResetEntryFields();
            return;
        }
        ListText = std::move(result.entries);
        // The fields keep the deleted entry's values, so it can be added back at once; loading
        // sets up the information box, which would otherwise lose its value.
        const std::string information = c_.Combo3.text();
        LoadEntries(list);
        c_.Combo3.setText(information);
    });
}

void Form1::Command_delete_Click() {
    const std::string name = selectedList();
    if (name.empty()) return;
    if (platform_.messageBox("ARE YA SURE YA WANT TO DELETE THE SELECTED LIST?",
                             ui::kYesNo | ui::kSecondDefault, "DELETE?") != ui::Answer::Yes ||
        platform_.messageBox("ARE YA REALLY SURE?",
                             ui::kYesNo | ui::kExclamation | ui::kSecondDefault,
                             "DELETE?") != ui::Answer::Yes) {
        return;
    }
    guarded([&] {
        finishEarlierChange();
        catalogue::deleteList(store_, name, indexStamp_, c_.List_list.count() == 1,
                              wholeList_ == name ? &listStamp_ : nullptr);
        LoadListNames();
    });
}

}  // namespace main_window
