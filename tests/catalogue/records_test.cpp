// The rules of the catalogue's records: entries, article lines and numbers, index lines, and the
// names a new list may take.
#include "catalogue/records.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <stdexcept>
#include <string>
#include <vector>

#include "catalogue/article_numbers.h"
#include "catalogue/entry_rules.h"
#include "catalogue/list_import.h"
#include "catalogue/store.h"
#include "tests/support/faulty_sys.h"
#include "tests/support/temp_folder.h"

namespace catalogue {
namespace {

const Entry kStar{"Star", "CD", "1", "first"};
const Entry kStarWars{"Star Wars", "DVD", "2", "second"};
const Entry kWars{"Wars", "LP", "3", ""};

using test_support::entryText;

// An entry found, as its four lines, or "none".
std::string found(std::string_view text, std::string_view title) {
    const auto entry = findEntry(text, title);
    return entry ? entryLines(*entry) : "none";
}

// "Star Wars" stands before the title it begins with and the one it ends with.
TEST(Records, FindEntryByItsWholeTitleIgnoringCase) {
    const std::string all = entryText({kStarWars, kStar, kWars});
    for (const Entry& e : {kStar, kStarWars, kWars}) EXPECT_EQ(found(all, e.title), entryLines(e));
    EXPECT_EQ(found(all, "Sta"), "none");
    EXPECT_EQ(found(all, "ar Wars"), "none");

    const std::string text = entryText({kStar, {"\xC9t\xE9", "CD", "1", "x"}});
    EXPECT_EQ(found(text, "STAR"), entryLines(kStar));  // the stored title comes back
    EXPECT_EQ(findEntry(text, "\xE9T\xC9")->title, "\xC9t\xE9");
    // The markers after the title line compare exactly: the entry's own fields, in order.
    EXPECT_EQ(found("<|?A\r\n<|'t\r\n<||\r\n<|*<|\r\n", "a"), "<|?A\r\n<|'t\r\n<||\r\n<|*<|\r\n");
    EXPECT_EQ(found("<|?A\r\n<|'t\r\n", "A"), "none");  // a torn entry is no entry
    // With two titles equal but for case, the first in file order is the one changed or removed;
    // how the others stay around it is the list edits' test.
    const Entry upper{"STAR", "x", "y", "z"};
    EXPECT_EQ(removeEntry(entryText({kWars, kStar, upper}), "star"), entryText({kWars, upper}));
    EXPECT_EQ(replaceEntry(entryText({kStar, upper}), "STAR", kWars), entryText({kWars, upper}));
}

// A text whose last line lacks its CR LF gets it before the new lines. (An empty one is the
// damaged-file table's empty entry file.)
TEST(Records, AppendEndsAnUnendedLastLineFirst) {
    EXPECT_EQ(appendEntry("<|?Star\r\n<|'CD\r\n<||1\r\n<|*first", kWars),
              entryText({kStar, kWars}));
}

// Older files could store the title tag inside a value. Only a line that starts one of the
// four-line entries is a title line: finding, the duplicate test, replacing and removing never
// take a tag inside a value (at a line's end, at the start of a type line, or in a title) for an
// entry.
TEST(Records, TitleTagsInsideValuesAreNoEntries) {
    const Entry a{"A", "<|?B", "1", "see <|?B"};
    const Entry b{"B", "CD", "2", "b"};
    const Entry c{"C", "LP", "3", "<|?C"};
    const std::string text = entryText({a, b, c});
    EXPECT_EQ(found(text, "b"), entryLines(b));
    EXPECT_EQ(found(text, "C"), entryLines(c));
    // A hand-edited type line that looks like B's title line, before B's own.
    EXPECT_EQ(found("<|?A\r\n<|?B\r\n<||1\r\n<|*i\r\n" + entryLines(b), "B"), entryLines(b));
    EXPECT_EQ(found(entryText({{"A<|?B", "CD", "1", ""}}), "B"), "none");  // inside a title
    const Entry changed{"N", "x", "y", "z"};
    EXPECT_EQ(replaceEntry(text, "A", changed), entryText({changed, b, c}));
    EXPECT_EQ(replaceEntry(text, "B", changed), entryText({a, changed, c}));
    EXPECT_EQ(removeEntry(text, "A"), entryText({b, c}));
    EXPECT_EQ(removeEntry(text, "C"), entryText({a, b}));
    EntrySpan span;
    ASSERT_TRUE(removeEntry(text, "A", &span));
    EXPECT_TRUE(span.oneEntry);
    // A text that stops short of the entry's four lines: the rest goes, and it is not one entry.
    EXPECT_EQ(removeEntry("<|?A\r\n<|'t\r\n", "A", &span), "");
    EXPECT_FALSE(span.oneEntry);
}

// A title's article line is the one whose text before the separator is the title, never one
// that merely begins or ends with it.
TEST(Records, ArticleLines) {
    const std::string articles =
        "Best of Star#*\\B001\r\n\r\nstar#*\\S001\r\nStar Wars#*\\S002\r\nWars#*\\W001\r\n";
    EXPECT_EQ(findArticleNumber(articles, "Star"), "S001");
    EXPECT_EQ(findArticleNumber(articles, "STAR WARS"), "S002");
    EXPECT_EQ(findArticleNumber(articles, "wars"), "W001");
    EXPECT_EQ(findArticleNumber(articles, "Best of Star"), "B001");
    EXPECT_EQ(findArticleNumber(articles, "of Star"), std::nullopt);
    EXPECT_EQ(findArticleNumber(articles, "Sta"), std::nullopt);
    EXPECT_EQ(findArticleNumber("Caf\xC9#*\\!001\r\n", "caf\xE9"), "!001");
    EXPECT_EQ(findArticleNumber("A#*\\A001", "a"), "A001");  // last line without CR LF
    // A lone LF is data of its line: "x\nWars" is one title, not a line "Wars".
    EXPECT_EQ(findArticleNumber("x\nWars#*\\W001\r\n", "Wars"), std::nullopt);
    EXPECT_EQ(findArticleNumber("x\nWars#*\\W001\r\n", "x\nWars"), "W001");
    EXPECT_EQ(articleLine("Star", "S001"), "Star#*\\S001\r\n");
}

TEST(Records, RemoveIndexLineTakesTheWholeLineIgnoringCase) {
    const std::string index = "Rock and Pop\r\nPOP\r\n\r\nPop\r\nJazz\r\n";
    EXPECT_EQ(removeIndexLine(index, "pop"), "Rock and Pop\r\n\r\nPop\r\nJazz\r\n");
    EXPECT_EQ(removeIndexLine(index, "JAZZ"), "Rock and Pop\r\nPOP\r\n\r\nPop\r\n");
    EXPECT_EQ(removeIndexLine(index, "Rock"), index);
    EXPECT_EQ(removeIndexLine(index, "and"), index);
    EXPECT_EQ(removeIndexLine("a\nPop\r\n", "Pop"), "a\nPop\r\n");  // one line "a\nPop"
}

TEST(ArticleNumbers, LetterOfTheFirstCharacter) {
    EXPECT_EQ(std::string({articleLetter('A'), articleLetter('a'), articleLetter('z')}), "AAZ");
    for (char c : {'2', ' ', '@', '`', '[', '{', '\0', '\xE9', '\xC9', '\xFF'}) {
        EXPECT_EQ(articleLetter(c), '!') << static_cast<int>(c);
    }
}

// Each case hands out numbers for a run of first characters, one addition after another, and
// ends with the counter text they leave.
TEST(ArticleNumbers, NumbersAndCounterTextsByteForByte) {
    struct Case {
        std::string counter, firsts, numbers, after;
    };
    const Case cases[] = {
        // The worked example; é files under "!".
        {std::string(kSkeletonCounter), "AB2a\351b", "A001 B001 !001 A002 !002 B002 ",
         "A#003\r\nB#003\r\n!#003\r\n"},
        {"A#005\r\n\r\nB#003\r\n\r\n", "BQ", "B003 Q001 ", "A#005\r\n\r\nB#004\r\n\r\nQ#002\r\n"},
        {"", "K", "K001 ", "K#002\r\n"},
        {"A#009", "AD", "A009 D001 ", "A#010\r\nD#002\r\n"},  // last line without its CR LF
        {"A#099\r\n", "A", "A099 ", "A#100\r\n"},
        // 999 is the last number: the record then reads 000, other letters go on.
        {"A#998\r\nB#005\r\n", "AAB", "A998 A999 B005 ", "A#000\r\nB#006\r\n"},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.counter + " + " + c.firsts);
        std::string counter = c.counter, numbers;
        for (char first : c.firsts) {
            EXPECT_EQ(counterProblem(counter, articleLetter(first)), CounterProblem::None);
            ArticleNumberResult r = nextArticleNumber(counter, first);
            counter = r.counterText;
            numbers += r.number + " ";
        }
        EXPECT_EQ(numbers, c.numbers);
        EXPECT_EQ(counter, c.after);
    }
}

TEST(ArticleNumbers, UsedUpAndDamagedRecordsAreRefusedForTheirLetterOnly) {
    for (std::string_view text :
         {"A#000\r\nB#006\r\n", "A#0x1\r\n", "A#12\r\n", "A#", "A", "A# 12\r\n", "A#-12\r\n"}) {
        SCOPED_TRACE(text);
        EXPECT_EQ(counterProblem(text, 'A'),
                  text.starts_with("A#000") ? CounterProblem::Exhausted : CounterProblem::Damaged);
        EXPECT_THROW(nextArticleNumber(text, 'a'), std::invalid_argument);
        EXPECT_EQ(counterProblem(text, 'B'), CounterProblem::None);
    }
}

// An import counts a letter's numbers on past its last one exactly as Adds one after another do.
TEST(ArticleNumbers, AnImportHandsOutWhatAddsInARowWould) {
    test_support::TempFolder folder;
    folder.put("pemla.dat", "Rock\r\n");
    folder.put("Rock.dat", "");
    folder.put("Rock.arn", "A#998\r\nB#005\r\n");
    Store store(folder.path());
    const ImportResult r = importCsv(store, "Rock", "title\na1\nA2\nb\nA3\nZed\na4\n");
    EXPECT_EQ(r.added, 4);
    ASSERT_EQ(r.refused.size(), 2u);
    EXPECT_EQ(r.refused[0].line, 5);
    EXPECT_EQ(r.refused[1].reason, r.refused[0].reason);
    EXPECT_NE(r.refused[0].reason.find("letter A (A001 to A999)"), std::string::npos);
    EXPECT_EQ(folder.get("Rock.art"), "a1#*\\A998\r\nA2#*\\A999\r\nb#*\\B005\r\nZed#*\\Z001\r\n");
    EXPECT_EQ(folder.get("Rock.arn"), "A#000\r\nB#006\r\nZ#002\r\n");
}

// The names "Create" takes for a new list and those it refuses, tried on a real folder: a refusal
// leaves every file as it was, the name's probe file included.
using test_support::SysCall;

TEST(ListNames, InUseReservedOrNoPortableFileNameAreRefusedTheRestTaken) {
    // The index, and for each name what "Create" says: in use ignoring case, a name a listed name
    // ends with, every reserved word in any case and every trailing part of one, the empty name;
    // no file name on every system; names that only begin like a list or hold a reserved word.
    // A full index is the list edits' test.
    const std::string inUse = "Hard Rock\r\nPop\r\n", blankAndNoLastCrLf = "Hard Rock\r\n\r\nOld";
    const std::tuple<std::string, std::vector<std::string>, std::string> cases[] = {
        {inUse,
         {"", "hard ROCK", "Rock", "k", " Rock", "EXPORT", "Print", "pemla", "iNFORMATION", "type",
          "port", "ation", "e", "MLA"},
         kNameInUse},
        {inUse,
         {"a/b", "a\\b", "C:", "why?", "*", "<x", "x>", "say \"hi\"", "a|b", "tab\there",
          std::string("nul\0x", 5), "del\x7f", "c1\x85", ".", ".."},
         kBadName},
        {blankAndNoLastCrLf, {"Hard", "exports", "myexport", "xpor", "Type A", "a.b", "..."}, ""},
    };
    for (const auto& [index, names, refusal] : cases) {
        test_support::TempFolder folder;
        folder.put("pemla.dat", index);
        // Files the user made that a probe would be named: they prove a name usable and stay.
        folder.put("type.del", "mine");
        folder.put("myexport.del", "mine");
        Store store(folder.path());
        for (const std::string& name : names) {
            EXPECT_EQ(checkNewListName(store, name).refusal, refusal) << "name \"" << name << "\"";
            EXPECT_EQ(folder.listing(), "myexport.del\npemla.dat\ntype.del\n") << name;
        }
        EXPECT_EQ(folder.get("pemla.dat") + folder.get("type.del") + folder.get("myexport.del"),
                  index + "minemine");
    }
}

// A file system that refuses the probe file (its open comes after the journal's), or will not
// delete it even when asked twice: the name is refused, and the probe and its record are left
// for the next start, which removes them.
TEST(ListNames, AProbeTheFolderRefusesIsLeftToTheNextStart) {
    for (const SysCall kind : {SysCall::Open, SysCall::Unlink}) {
        SCOPED_TRACE(test_support::sysCallName(kind));
        test_support::TempFolder folder;
        folder.put("pemla.dat", "Pop\r\n");
        test_support::FaultySys sys;
        sys.failNext(kind, kind == SysCall::Open ? 2 : 1, kind == SysCall::Open ? EINVAL : EACCES,
                     2);
        Store store(folder.path(), sys);
        EXPECT_EQ(checkNewListName(store, "Jazz").refusal, kBadName);
        Store(folder.path()).recover();
        EXPECT_EQ(folder.listing(), "pemla.dat\n");
    }
}

}  // namespace
}  // namespace catalogue
