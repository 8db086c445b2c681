#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "catalogue/records.h"
#include "catalogue/store.h"

// The changes a user makes to the catalogue: adding, changing and deleting an entry, creating
// and deleting a list. Each one plans all of its files in one transaction and commits it, so
// they change together or not at all. What the user is refused comes back as an EditResult; a
// file that cannot be read or written throws CatalogueError (ChangedOnDisk when a file the
// change was computed from is no longer the one that was read), and nothing has changed then.
namespace catalogue {

// What a change was refused for.
enum class Refused {
    None,
    BadEntry,        // no title, or a line break or record marker in a field
    DuplicateTitle,  // the list holds the title already
    NotReadWhole,    // the list's entry file did not load whole, so it is not written
    ListFull,        // the list holds 32767 titles
    NumbersUsedUp,   // every article number of the title's letter is handed out
    BadName,         // a name the folder cannot take as a file name
    NameInUse,       // a listed or reserved name
    CatalogueFull,   // the index holds 32767 lists
};

struct EditResult {
    Refused refused = Refused::None;
    // The words the user is told when refused.
    std::string refusal;
    // The list's entry text after an add, change or delete.
    std::string entries;
    // The article number handed out by an add, or by a change that needed one.
    std::string articleNumber;
    // A delete that took the last title gave the list the placeholder entry.
    bool emptied = false;

    explicit operator bool() const { return refused == Refused::None; }
};

// A list as the window read it: the changes to it are computed from this, and refused (nothing
// written) when its entry file has changed on disk since.
struct OpenList {
    std::string name;
    std::string_view entries;  // the entry file's text
    FileStamp stamp;           // the entry file when it was read
    bool whole = false;        // `entries` holds the whole file
    int titles = 0;            // how many titles the list shows
};

// Finishes a change an earlier run left unfinished. Throws ChangedOnDisk naming the journal
// when that changed catalogue files (what was read before is then out of date), and
// CatalogueError when it cannot be finished.
void finishEarlierChange(Store& store);

// Plans the next article number for a title's first character in the list's counter file, read
// within `t`. Nothing (and nothing planned) with the words in `refusal` when the letter's numbers
// are used up; throws CatalogueError when the counter file is missing or damaged.
std::optional<std::string> planArticleNumber(Transaction& t, const std::string& list,
                                             char firstCharacter, std::string& refusal);

// Plans the placeholder skeleton for a list's entry, article and counter files.
void planEmptyList(Transaction& t, const std::string& list);

// Adds the entry at the end of the list, its article number at the end of the article file.
EditResult addEntry(Store& store, const OpenList& list, const Entry& entry);

// Replaces the entry titled `oldTitle` with `entry` in place. A new title keeps its article
// number when its letter stays, and gets the next one of its letter otherwise; a title without
// an article line gets one.
EditResult changeEntry(Store& store, const OpenList& list, const std::string& oldTitle,
                       const Entry& entry);

// Removes the entry titled `title` and its article line; the last title gives way to the
// placeholder entry and fresh numbering.
EditResult deleteEntry(Store& store, const OpenList& list, const std::string& title);

// Removes a list's files and its index line. `index` is the list index as the window read it;
// `open` the deleted list's entry file when the window shows it whole. The last list gives way
// to the placeholder list.
void deleteList(Store& store, const std::string& name, const FileStamp& index, bool lastList,
                const FileStamp* open);

// Creates an empty list, its index line and files; `informationFlag` goes to its flag file (1:
// with the information column, 0: without).
EditResult createList(Store& store, const std::string& name, int informationFlag);

}  // namespace catalogue
