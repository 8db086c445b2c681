#include "catalogue/list_edits.h"

#include "catalogue/byte_scan.h"
#include "catalogue/catalogue_error.h"
#include "catalogue/entry_rules.h"
#include "catalogue/file_text.h"
#include "catalogue/latin1.h"

namespace catalogue {

namespace {

EditResult refused(Refused why, std::string words) {
    EditResult result;
    result.refused = why;
    result.refusal = std::move(words);
    return result;
}

EditResult notReadWhole(const OpenList& list) {
    return refused(Refused::NotReadWhole,
                   "The list \"" + list.name +
                       "\" could not be read whole, so it is left unchanged. Open it again once "
                       "its files are in order.");
}

char upperFirst(const std::string& text) {
    return text.empty() ? '\0' : static_cast<char>(upperByte(static_cast<unsigned char>(text[0])));
}

CatalogueError missingEntry(const OpenList& list, const std::string& title) {
    return CatalogueError(entryFile(list.name), "the entry \"" + title + "\" is not in the file");
}

// The title as the entry file spells it: a lookup ignores case, the list shows the file's own.
std::string titleAt(std::string_view entries, const EntrySpan& found, const std::string& title) {
    return std::string(entries.substr(found.at + kTitleTag.size(), title.size()));
}

}  // namespace

void finishEarlierChange(Store& store) {
    if (store.settle()) throw ChangedOnDisk(std::string(kJournalName), "it was finished");
}

std::optional<std::string> planArticleNumber(Transaction& t, const std::string& list,
                                             char firstCharacter, std::string& refusal) {
    const std::string file = counterFile(list);
    const std::string counter = t.readText(file);
    std::optional<ArticleNumberResult> next = handOutNumber(counter, file, firstCharacter, refusal);
    if (!next) return std::nullopt;
    t.write(file, next->counterText);
    return std::move(next->number);
}

void planEmptyList(Transaction& t, const std::string& list) {
    t.write(entryFile(list), kSkeletonEntries);
    t.write(articleFile(list), kSkeletonArticles);
    t.write(counterFile(list), kSkeletonCounter);
}

EditResult addEntry(Store& store, const OpenList& list, const Entry& entry) {
    clearUpperVectorHalves();  // the scans of the list's texts below
    if (std::string words = entryRefusal(entry); !words.empty()) {
        return refused(Refused::BadEntry, std::move(words));
    }
    if (isDuplicateTitle(list.entries, entry.title)) {
        return refused(Refused::DuplicateTitle, kDuplicateTitle);
    }
    if (!list.whole) return notReadWhole(list);
    if (list.titles >= kMaxEntries) return refused(Refused::ListFull, kListFull);

    EditResult result;
    Transaction t = store.begin();
    t.expect(entryFile(list.name), list.stamp);
    t.write(entryFile(list.name), appendEntry(list.entries, entry));
    std::string words;
    std::optional<std::string> number = planArticleNumber(t, list.name, entry.title[0], words);
    if (!number) return refused(Refused::NumbersUsedUp, std::move(words));
    result.articleNumber = std::move(*number);
    const std::string articles = articleFile(list.name);
    // A file text ends with its line end already.
    std::string text = t.readTextIfExists(articles).value_or("");
    text += articleLine(entry.title, result.articleNumber);
    t.write(articles, std::move(text));
    t.commit();
    result.stamp = t.written(entryFile(list.name));
    result.entries = t.takeWritten(entryFile(list.name));
    result.addedTitle = entry.title;
    return result;
}

EditResult changeEntry(Store& store, const OpenList& list, const std::string& oldTitle,
                       const Entry& entry) {
    clearUpperVectorHalves();  // the scans of the list's texts below
    if (std::string words = entryRefusal(entry); !words.empty()) {
        return refused(Refused::BadEntry, std::move(words));
    }
    if (!list.whole) return notReadWhole(list);
    EntrySpan found;
    std::optional<std::string> newText = replaceEntry(list.entries, oldTitle, entry, &found);
    if (!newText) throw missingEntry(list, oldTitle);

    EditResult result;
    Transaction t = store.begin();
    t.expect(entryFile(list.name), list.stamp);
    const std::string articleName = articleFile(list.name);
    // A change that keeps the title needs the article file only to give a title that lacks its
    // article line one; without the file it leaves articles alone.
    const bool sameTitle = entry.title == oldTitle;
    std::optional<std::string> articles =
        sameTitle ? t.readTextIfExists(articleName) : t.readText(articleName);
    // Looked for once; the article text is then edited where it was read.
    const std::size_t line = articles ? findArticleLine(*articles, oldTitle) : std::string::npos;
    const bool hasLine = line != std::string::npos;
    if (articles && (!sameTitle || !hasLine)) {
        if (!hasLine || upperFirst(entry.title) != upperFirst(oldTitle)) {
            std::string words;
            std::optional<std::string> number =
                planArticleNumber(t, list.name, entry.title[0], words);
            if (!number) return refused(Refused::NumbersUsedUp, std::move(words));
            result.articleNumber = std::move(*number);
            t.write(articleName,
                    removeArticleLineAt(std::move(*articles), line,
                                        articleLine(entry.title, result.articleNumber)));
        } else {
            t.write(articleName,
                    renameArticleLineAt(std::move(*articles), line, oldTitle.size(), entry.title));
        }
    }
    t.write(entryFile(list.name), std::move(*newText));
    t.commit();
    result.stamp = t.written(entryFile(list.name));
    if (found.oneEntry) {
        result.removedTitle = titleAt(list.entries, found, oldTitle);
        result.addedTitle = entry.title;
    }
    result.entries = t.takeWritten(entryFile(list.name));
    return result;
}

EditResult deleteEntry(Store& store, const OpenList& list, const std::string& title) {
    clearUpperVectorHalves();  // the scans of the list's texts below
    EditResult result;
    Transaction t = store.begin();
    if (list.whole) t.expect(entryFile(list.name), list.stamp);
    if (list.titles == 1) {
        planEmptyList(t, list.name);
        t.commit();
        result.stamp = t.written(entryFile(list.name));
        result.entries = kSkeletonEntries;
        result.emptied = true;
        return result;
    }
    if (!list.whole) return notReadWhole(list);
    EntrySpan found;
    std::optional<std::string> newText = removeEntry(list.entries, title, &found);
    if (!newText) throw missingEntry(list, title);
    t.write(entryFile(list.name), std::move(*newText));
    const std::string articleName = articleFile(list.name);
    if (auto articles = t.readTextIfExists(articleName)) {
        const std::size_t line = findArticleLine(*articles, title);
        t.write(articleName, removeArticleLineAt(std::move(*articles), line));
    }
    t.commit();
    result.stamp = t.written(entryFile(list.name));
    if (found.oneEntry) result.removedTitle = titleAt(list.entries, found, title);
    result.entries = t.takeWritten(entryFile(list.name));
    return result;
}

void deleteList(Store& store, const std::string& name, const FileStamp& index, bool lastList,
                const FileStamp* open) {
    Transaction t = store.begin();
    // The window's picture of the lists, and of the list going when it is the open one.
    t.expect(kIndexFile, index);
    if (open != nullptr) t.expect(entryFile(name), *open);
    std::string indexText = forWriting(t.readText(kIndexFile));
    // Files that are already missing are simply not there to delete.
    for (const std::string& file :
         {entryFile(name), counterFile(name), articleFile(name), flagFile(name)}) {
        t.remove(file);
    }
    if (lastList) {
        // The catalogue keeps one list: the placeholder list takes the last one's place.
        // Planned after the deletions, so deleting the placeholder list itself renews it.
        const std::string placeholder(kPlaceholderList);
        indexText += placeholder + "\r\n";
        planEmptyList(t, placeholder);
        t.write(flagFile(placeholder), fileNumber(1));
    }
    t.write(kIndexFile, removeIndexLine(indexText, name));
    t.commit();
}

EditResult createList(Store& store, const std::string& name, int informationFlag) {
    const NewListCheck check = checkNewListName(store, name);
    if (check.refusal == kBadName) return refused(Refused::BadName, kBadName);
    if (check.refusal == kNameInUse) return refused(Refused::NameInUse, kNameInUse);
    if (check.refusal == kCatalogueFull) return refused(Refused::CatalogueFull, kCatalogueFull);

    // The index line and the four files appear together or not at all, so a failure never
    // leaves a listed name without its files.
    Transaction t = store.begin();
    t.write(kIndexFile, check.index + name + "\r\n");
    planEmptyList(t, name);
    t.write(flagFile(name), fileNumber(informationFlag));
    t.commit();
    return {};
}

}  // namespace catalogue
