// Adding, changing and deleting entries, creating and deleting lists: the files each one leaves,
// byte for byte, and what each refuses with nothing written.
#include "catalogue/list_edits.h"

#include <gtest/gtest.h>

#include "catalogue/entry_rules.h"
#include "catalogue/file_text.h"
#include "tests/support/faulty_sys.h"
#include "tests/support/temp_folder.h"

namespace catalogue {
namespace {

using namespace test_support;  // folders and the texts of the list files
using Lines = std::vector<std::string>;
using Articles = std::vector<std::pair<std::string, std::string>>;

const std::string kSkeletonDat(kSkeletonEntries), kSkeletonArt(kSkeletonArticles);
const std::string kMarks = ": the list's files use it to mark their records.";

class ListEdits : public ::testing::Test {
  protected:
    // Rock, the placeholder list Jazz, and an index naming both.
    void SetUp() override { putRock(); }
    void putRock() { test_support::putRock(folder, {"Jazz"}); }
    // The list as the main window reads it.
    OpenList read(const std::string& name) {
        FileStamp stamp;
        const std::string bytes = store.readBytes(entryFile(name), &stamp);
        text_ = toFileText(bytes);
        return {name, text_, stamp, true, static_cast<int>(entryTitles(bytes)->size())};
    }
    void expectList(const std::string& name, const std::string& dat, const std::string& art,
                    const std::string& arn) const {
        EXPECT_EQ(folder.get(name + ".dat"), dat);
        EXPECT_EQ(folder.get(name + ".art"), art);
        EXPECT_EQ(folder.get(name + ".arn"), arn);
    }
    void expectRefused(const EditResult& result, Refused why, const std::string& words,
                       const Files& before) const {
        EXPECT_EQ(result.refused, why);
        EXPECT_EQ(result.refusal, words);
        EXPECT_EQ(snapshot(folder.path()), before);
    }

    TempFolder folder;
    Store store{folder.path()};
    std::string text_;
};

// Titles that begin or end another are no duplicates; a letter new to the counter is appended.
TEST_F(ListEdits, AddAppendsTheEntryAndTheNextNumberOfItsFirstLetter) {
    const struct {
        const char* list;
        Entry entry;
        const char* number;
        Lines counter;
    } cases[] = {
        {"Rock", {"ab", "CD", "1", ""}, "A003", {"A#004", "Z#002", "X#002", "!#002"}},
        {"Rock", {"abcde", "CD", "1", ""}, "A003", {"A#004", "Z#002", "X#002", "!#002"}},
        {"Rock", {"bc", "CD", "1", ""}, "B001", {"A#003", "Z#002", "X#002", "!#002", "B#002"}},
        {"Rock", {" ", "CD", "1", ""}, "!002", {"A#003", "Z#002", "X#002", "!#003"}},
        {"Rock", {"\351clair", "CD", "1", "a#*\\b"}, "!002", {"A#003", "Z#002", "X#002", "!#003"}},
        // The placeholder holds A001 without having counted it: the first A-title gets A001 too.
        {"Jazz", {"apple", "CD", "1", "Info"}, "A001", {"A#002"}},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.entry.title);
        putRock();
        const std::string dat = folder.get(std::string(c.list) + ".dat");
        const std::string art = folder.get(std::string(c.list) + ".art");
        const EditResult result = addEntry(store, read(c.list), c.entry);
        ASSERT_TRUE(result) << result.refusal;
        EXPECT_EQ(result.articleNumber, c.number);
        EXPECT_EQ(result.entries, dat + entryText({c.entry}));
        expectList(c.list, result.entries, art + articleText({{c.entry.title, c.number}}),
                   crlf(c.counter));
    }
    // One space may stand twice.
    ASSERT_TRUE(addEntry(store, read("Rock"), {" ", "CD", "1", ""}));
}

TEST_F(ListEdits, AddRefusesWhatTheFilesCannotHoldOrTheListCannotTakeAndWritesNothing) {
    std::vector<std::tuple<Entry, Refused, std::string>> cases = {
        {{"Dots#*\\here", "CD", "1", "Copy"},
         Refused::BadEntry,
         "The title cannot hold \"#*\\\"" + kMarks},
        {{"Title", "CD", "1", "a\rb"},
         Refused::BadEntry,
         "The information cannot hold a line break" + kMarks},
    };
    for (const std::string tag : {"<|?", "<|'", "<||", "<|*"}) {
        const std::string holds = " cannot hold \"" + tag + "\"" + kMarks;
        cases.emplace_back(Entry{"a" + tag + "b", "CD", "1", ""}, Refused::BadEntry,
                           "The title" + holds);
        cases.emplace_back(Entry{"T", "a" + tag, "1", ""}, Refused::BadEntry, "The type" + holds);
        cases.emplace_back(Entry{"T", "CD", tag, ""}, Refused::BadEntry,
                           "The number of discs" + holds);
        cases.emplace_back(Entry{"T", "CD", "1", tag + "b"}, Refused::BadEntry,
                           "The information" + holds);
    }
    // The duplicate test ignores case and looks at whole titles only.
    for (const std::string title : {"ABC", "zebra", "XABC", "1ST"}) {
        cases.emplace_back(Entry{title, "CD", "1", ""}, Refused::DuplicateTitle, kDuplicateTitle);
    }
    const Files before = snapshot(folder.path());
    for (const auto& [entry, why, words] : cases) {
        SCOPED_TRACE(entry.title + "|" + entry.type + "|" + entry.discs + "|" + entry.information);
        expectRefused(addEntry(store, read("Rock"), entry), why, words, before);
    }
    OpenList full = read("Rock");
    full.titles = kMaxEntries;
    expectRefused(addEntry(store, full, {"New", "CD", "1", ""}), Refused::ListFull, kListFull,
                  before);
    full.titles = kMaxEntries - 1;
    EXPECT_TRUE(addEntry(store, full, {"New", "CD", "1", ""}));
}

// "000" stands for a letter whose numbers are all handed out (the counter's own suite hands out
// the last one and goes on with other letters); neither an add nor a change gets another of it.
TEST_F(ListEdits, ALettersNumbersEndAt999) {
    folder.putList("Full", entryText({{"Bass", "CD", "1", ""}}), articleText({{"Bass", "B004"}}),
                   crlf({"A#000", "B#005"}));
    const std::string usedUp =
        "Every article number of the letter A (A001 to A999) has been handed out in this list, "
        "so no other title that files under this letter can be stored in it.";
    const Files before = snapshot(folder.path());
    expectRefused(addEntry(store, read("Full"), {"apple", "CD", "1", ""}), Refused::NumbersUsedUp,
                  usedUp, before);
    expectRefused(changeEntry(store, read("Full"), "Bass", {"Aqua", "CD", "1", ""}),
                  Refused::NumbersUsedUp, usedUp, before);
}

// A change keeps the entry's place. A new title keeps its number and line when its first letter
// stays and gets the next number of its letter (its line moving to the end) when it changes.
TEST_F(ListEdits, ChangeKeepsThePlaceAndKeepsOrRenewsTheNumberByTheFirstLetter) {
    const struct {
        std::string from, to;
        std::string number;  // empty: the number and the line's place are kept
        Lines counter;       // empty: the counter file is left as it was
    } cases[] = {
        {"Zebra", "Zebra", "", {}},  // the first entry, its other fields only
        {"abc", "ABC", "", {}},      // a middle one, only the case of its title
        {"abcd", "alpha", "", {}},
        {"abc", "Quartz", "Q001", {"A#003", "Z#002", "X#002", "!#002", "Q#002"}},
        // The old title ends the new one, and "abc"'s line stays.
        {"abcd", "Babcd", "B001", {"A#003", "Z#002", "X#002", "!#002", "B#002"}},
        // The last entry. Two digits file under the same letter, but the first character changed.
        {"1st", "2nd", "!002", {"A#003", "Z#002", "X#002", "!#003"}},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.from + " -> " + c.to);
        putRock();
        const Entry changed{c.to, "Vinyl", "4", "Signed"};
        const EditResult result = changeEntry(store, read("Rock"), c.from, changed);
        ASSERT_TRUE(result) << result.refusal;
        EXPECT_EQ(result.articleNumber, c.number);
        std::vector<Entry> dat = kRock;
        for (Entry& e : dat) {
            if (e.title == c.from) e = changed;
        }
        Articles art;
        for (const auto& line : kRockArticles) {
            if (line.first != c.from) {
                art.push_back(line);
            } else if (c.number.empty()) {
                art.push_back({c.to, line.second});
            }
        }
        if (!c.number.empty()) art.push_back({c.to, c.number});
        EXPECT_EQ(result.entries, entryText(dat));
        expectList("Rock", entryText(dat), articleText(art),
                   crlf(c.counter.empty() ? kRockCounter : c.counter));
    }
}

// A title without an article line gets one when changed, even keeping its title; a change that
// keeps the title needs no article file, one that renames does.
TEST_F(ListEdits, ChangeGivesATitleWithoutALineOneAndNeedsTheArticleFileOnlyToRename) {
    const Articles art = {{"xabc", "X001"}, {"ABC", "B123"}};
    folder.put("Rock.art", articleText(art));
    ASSERT_TRUE(changeEntry(store, read("Rock"), "abcd", {"abcd", "Vinyl", "1", ""}));
    EXPECT_EQ(folder.get("Rock.art"), articleText(art) + articleText({{"abcd", "A003"}}));
    putRock();
    folder.remove(("Rock.art"));
    ASSERT_TRUE(changeEntry(store, read("Rock"), "Zebra", {"Zebra", "Vinyl", "4", ""}));
    EXPECT_FALSE(folder.has("Rock.art"));
    EXPECT_EQ(folder.get("Rock.arn"), crlf(kRockCounter));
    const Files before = snapshot(folder.path());
    EXPECT_THROW(changeEntry(store, read("Rock"), "Zebra", {"Zulu", "CD", "1", ""}),
                 CatalogueError);
    EXPECT_THROW(changeEntry(store, read("Rock"), "Gone", {"Gone", "CD", "1", ""}), CatalogueError);
    expectRefused(changeEntry(store, read("Rock"), "Zebra", {"Ze\nbra", "CD", "1", ""}),
                  Refused::BadEntry, "The title cannot hold a line break" + kMarks, before);
}

// A change of one file is made durable by flushing the folder after its rename; a failed flush
// is tried once more before it would be reported, as the change is made by then.
TEST_F(ListEdits, ChangesFlushEveryFileAndTheFolderAfterEachStep) {
    FaultySys sys;
    Store flushed(folder.path(), sys);
    sys.failNext(SysCall::Fsync, 2, EIO);
    ASSERT_TRUE(changeEntry(flushed, read("Rock"), "Zebra", {"Zebra", "LP", "2", ""}));
    EXPECT_EQ(sys.calls(SysCall::Fsync), 3);  // the second failed, and was tried again
    // An add changes three files through the journal: the three staged files and the journal
    // are flushed, and the folder once the journal is in it, after the renames (before the
    // journal may go) and after the journal is gone.
    FaultySys counted;
    Store journaled(folder.path(), counted);
    ASSERT_TRUE(addEntry(journaled, read("Rock"), {"Blues", "LP", "2", ""}));
    EXPECT_EQ(counted.calls(SysCall::Fsync), 7);
}

TEST_F(ListEdits, DeleteRemovesTheEntryAndItsArticleLineOnly) {
    // The first entry of the file, a middle one with abcd before it, and the last one.
    for (const std::size_t at : {0u, 2u, 4u}) {
        const std::string title = kRock[at].title;
        SCOPED_TRACE(title);
        putRock();
        const EditResult result = deleteEntry(store, read("Rock"), title);
        ASSERT_TRUE(result);
        EXPECT_FALSE(result.emptied);
        std::vector<Entry> dat = kRock;
        dat.erase(dat.begin() + static_cast<std::ptrdiff_t>(at));
        Articles art;
        for (const auto& line : kRockArticles) {
            if (line.first != title) art.push_back(line);
        }
        EXPECT_EQ(result.entries, entryText(dat));
        EXPECT_EQ(result.removedTitle, title);
        expectList("Rock", entryText(dat), articleText(art), crlf(kRockCounter));
    }
    // Without an article file, the entry alone goes.
    putRock();
    folder.remove(("Rock.art"));
    ASSERT_TRUE(deleteEntry(store, read("Rock"), "abc"));
    EXPECT_FALSE(folder.has("Rock.art"));
    EXPECT_THROW(deleteEntry(store, read("Rock"), "Gone"), CatalogueError);
}

// A list that did not load whole is never written from what was read. (An add is refused
// before it could be, by the damaged-file table in the fault tests.)
TEST_F(ListEdits, AChangeOrDeleteLeavesAListNotReadWholeUnchanged) {
    OpenList partial = read("Rock");
    partial.whole = false;
    const std::string words =
        "The list \"Rock\" could not be read whole, so it is left unchanged. Open it again once "
        "its files are in order.";
    const Files before = snapshot(folder.path());
    expectRefused(changeEntry(store, partial, "Zebra", {"Zebra", "CD", "1", ""}),
                  Refused::NotReadWhole, words, before);
    expectRefused(deleteEntry(store, partial, "Zebra"), Refused::NotReadWhole, words, before);
}

// The last title gives way to the placeholder and numbering starts again; the flag stays.
TEST_F(ListEdits, DeletingTheOnlyEntryWritesTheSkeleton) {
    folder.putList("Solo", entryText({{"Jazz Album", "CD", "2", "Copy"}}),
                   articleText({{"Jazz Album", "J001"}}), crlf({"A#004", "J#002"}), " 0 \r\n");
    const EditResult result = deleteEntry(store, read("Solo"), "whatever is selected");
    ASSERT_TRUE(result);
    EXPECT_TRUE(result.emptied);
    expectList("Solo", kSkeletonDat, kSkeletonArt, "A#001\r\n");
    EXPECT_EQ(folder.get("Solo.inf"), " 0 \r\n");
}

// The last list gives way to the placeholder list; the placeholder list itself, with an entry
// and no flag file as older copies left it, is renewed rather than lost.
TEST_F(ListEdits, DeletingTheOnlyListLeavesThePlaceholderList) {
    const std::string placeholder(kPlaceholderList);
    for (const char* ext : {".dat", ".art", ".arn", ".inf"}) {
        folder.remove(("Jazz" + std::string(ext)));
    }
    folder.put("pemla.dat", crlf({"Rock"}));
    const Files expected = {{"pemla.dat", crlf({placeholder})},
                            {placeholder + ".dat", kSkeletonDat},
                            {placeholder + ".art", kSkeletonArt},
                            {placeholder + ".arn", "A#001\r\n"},
                            {placeholder + ".inf", " 1 \r\n"}};
    for (const std::string& list : {std::string("Rock"), placeholder}) {
        SCOPED_TRACE(list);
        deleteList(store, list, store.stampOf(kIndexFile), true, nullptr);
        EXPECT_EQ(snapshot(folder.path()), expected);
        folder.putList(placeholder, kSkeletonDat + entryText({{"Mine", "CD", "1", ""}}),
                       kSkeletonArt, "A#002\r\n");
        folder.remove((placeholder + ".inf"));
    }
}

// The files a new list gets are held byte for byte by the end-to-end run and its flag by the
// new-list dialog's test; here the refusals, each writing nothing.
TEST_F(ListEdits, CreateRefusesATakenOrBadNameAndAFullCatalogue) {
    const Files before = snapshot(folder.path());
    // Which names are taken is the list names' test; a refused one writes nothing.
    expectRefused(createList(store, "rock", 1), Refused::NameInUse, kNameInUse, before);
    expectRefused(createList(store, "a/b", 1), Refused::BadName, kBadName, before);
    Lines lists(kMaxEntries - 1, "L");
    folder.put("pemla.dat", crlf(lists));
    ASSERT_TRUE(createList(store, "One more", 1));
    const Files full = snapshot(folder.path());
    expectRefused(createList(store, "Too many", 1), Refused::CatalogueFull, kCatalogueFull, full);
}

}  // namespace
}  // namespace catalogue
