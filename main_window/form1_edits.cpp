// Adding, changing and deleting entries, and deleting lists. Each operation plans all of its
// files in one transaction, so they change together or not at all.
#include "catalogue/article_numbers.h"
#include "catalogue/catalogue_error.h"
#include "catalogue/entry_rules.h"
#include "catalogue/file_text.h"
#include "catalogue/latin1.h"
#include "catalogue/records.h"
#include "main_window/form1.h"

namespace main_window {

using catalogue::CatalogueError;

namespace {

char upperFirst(const std::string& text) {
    return text.empty()
               ? '\0'
               : static_cast<char>(catalogue::upperByte(static_cast<unsigned char>(text.front())));
}

}  // namespace

catalogue::Entry Form1::fieldsAsEntry() const {
    catalogue::Entry entry{c_.Text1.text(), c_.Combo1.text(), c_.Combo2.text(), c_.Combo3.text()};
    if (std::string refusal = catalogue::entryRefusal(entry); !refusal.empty()) {
        throw Refusal{std::move(refusal)};
    }
    return entry;
}

void Form1::requireWholeList(const std::string& list) const {
    if (wholeList_ != list) {
        throw Refusal{"The list \"" + list +
                      "\" could not be read whole, so it is left unchanged. Open it again once "
                      "its files are in order."};
    }
}

void Form1::NextArticleNumber(char firstCharacter, const std::string& list,
                              catalogue::Transaction& t) {
    const std::string file = catalogue::counterFile(list);
    const std::string counter = t.readText(file);
    std::string refusal;
    std::optional<catalogue::ArticleNumberResult> next =
        catalogue::handOutNumber(counter, file, firstCharacter, refusal);
    if (!next) throw Refusal{refusal};
    t.write(file, next->counterText);
    ArticleNumber = next->number;
}

void Form1::WriteEmptyList(const std::string& name, catalogue::Transaction& t) {
    t.write(catalogue::entryFile(name), catalogue::kSkeletonEntries);
    t.write(catalogue::articleFile(name), catalogue::kSkeletonArticles);
    t.write(catalogue::counterFile(name), catalogue::kSkeletonCounter);
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
        const catalogue::Entry entry = fieldsAsEntry();
        if (catalogue::isDuplicateTitle(ListText, entry.title)) {
            platform_.messageBox(catalogue::kDuplicateTitle, ui::kCritical, "Error");
            return;
        }
        requireWholeList(list);
        if (EntryCount >= catalogue::kMaxEntries) {
            throw Refusal{catalogue::kListFull};
        }
        catalogue::Transaction t = store_.begin();
        t.expect(catalogue::entryFile(list), listStamp_);
        const std::string newText = catalogue::appendEntry(ListText, entry);
        t.write(catalogue::entryFile(list), newText);
        NextArticleNumber(entry.title.front(), list, t);
        const std::string articleFile = catalogue::articleFile(list);
        std::string articles = catalogue::forWriting(t.readTextIfExists(articleFile).value_or(""));
        articles += catalogue::articleLine(entry.title, ArticleNumber);
        t.write(articleFile, articles);
        t.commit();
        ListText = newText;
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
        requireWholeList(list);
        std::optional<std::string> newText = catalogue::replaceEntry(ListText, *oldTitle, entry);
        if (!newText) {
            throw CatalogueError(catalogue::entryFile(list),
                                 "the entry \"" + *oldTitle + "\" is not in the file");
        }
        catalogue::Transaction t = store_.begin();
        t.expect(catalogue::entryFile(list), listStamp_);
        const std::string articleFile = catalogue::articleFile(list);
        // A change that keeps the title needs the article file only to give a title that lacks
        // its article line one; without the file it leaves articles alone.
        const bool sameTitle = entry.title == *oldTitle;
        const std::optional<std::string> articleText =
            sameTitle ? t.readTextIfExists(articleFile) : t.readText(articleFile);
        const std::string articles = articleText.value_or("");
        const bool hasLine = catalogue::findArticleLine(articles, *oldTitle) != std::string::npos;
        if (articleText && (!sameTitle || !hasLine)) {
            if (!hasLine || upperFirst(entry.title) != upperFirst(*oldTitle)) {
                NextArticleNumber(entry.title.front(), list, t);
                std::string moved = catalogue::removeArticleLine(articles, *oldTitle);
                moved += catalogue::articleLine(entry.title, ArticleNumber);
                t.write(articleFile, moved);
            } else {
                t.write(articleFile,
                        *catalogue::renameArticleLine(articles, *oldTitle, entry.title));
            }
        }
        t.write(catalogue::entryFile(list), *newText);
        t.commit();
        ListText = *newText;
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
        catalogue::Transaction t = store_.begin();
        if (wholeList_ == list) t.expect(catalogue::entryFile(list), listStamp_);
        if (c_.List1.count() == 1) {
            WriteEmptyList(list, t);
            t.commit();
            LoadEntries(list);
            ResetEntryFields();
            return;
        }
        requireWholeList(list);
        std::optional<std::string> newText = catalogue::removeEntry(ListText, *title);
        if (!newText) {
            throw CatalogueError(catalogue::entryFile(list),
                                 "the entry \"" + *title + "\" is not in the file");
        }
        t.write(catalogue::entryFile(list), *newText);
        const std::string articleFile = catalogue::articleFile(list);
        if (auto articles = t.readTextIfExists(articleFile)) {
            t.write(articleFile, catalogue::removeArticleLine(*articles, *title));
        }
        t.commit();
        ListText = *newText;
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
        catalogue::Transaction t = store_.begin();
        // The window's picture of the lists, and of the list going when it is the open one.
        t.expect(catalogue::kIndexFile, indexStamp_);
        if (wholeList_ == name) t.expect(catalogue::entryFile(name), listStamp_);
        std::string index = catalogue::forWriting(t.readText(catalogue::kIndexFile));
        // Files that are already missing are simply not there to delete.
        for (const std::string& file : {catalogue::entryFile(name), catalogue::counterFile(name),
                                        catalogue::articleFile(name), catalogue::flagFile(name)}) {
            t.remove(file);
        }
        if (c_.List_list.count() == 1) {
            // The catalogue keeps one list: the placeholder list takes the last one's place.
            // Planned after the deletions, so deleting the placeholder list itself renews it.
            const std::string placeholder(catalogue::kPlaceholderList);
            index += placeholder + "\r\n";
            WriteEmptyList(placeholder, t);
            t.write(catalogue::flagFile(placeholder), catalogue::fileNumber(1));
        }
        t.write(catalogue::kIndexFile, catalogue::removeIndexLine(index, name));
        t.commit();
        LoadListNames();
    });
}

}  // namespace main_window
