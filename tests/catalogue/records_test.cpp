#include "catalogue/records.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <string>
#include <vector>

namespace catalogue {
namespace {

const Entry kStar{"Star", "CD", "1", "first"};
const Entry kStarWars{"Star Wars", "DVD", "2", "second"};
const Entry kWars{"Wars", "LP", "3", ""};

std::string entriesOf(const std::vector<Entry>& entries) {
    std::string text;
    for (const Entry& e : entries) text += entryLines(e);
    return text;
}

// An entry found, as its four lines, or "none".
std::string found(std::string_view text, std::string_view title) {
    const auto entry = findEntry(text, title);
    return entry ? entryLines(*entry) : "none";
}

TEST(Records, FindEntryByTitleInAnyFileOrder) {
    std::vector<Entry> all = {kStar, kStarWars, kWars};
    const auto byTitle = [](auto& a, auto& b) { return a.title < b.title; };
    do {
        const std::string text = entriesOf(all);
        for (const Entry& e : all) EXPECT_EQ(found(text, e.title), entryLines(e)) << text;
        EXPECT_EQ(found(text, "Sta"), "none");
        EXPECT_EQ(found(text, "ar Wars"), "none");
    } while (std::next_permutation(all.begin(), all.end(), byTitle));

    const std::string text = entriesOf({kStar, {"\xC9t\xE9", "CD", "1", "x"}});
    EXPECT_EQ(found(text, "STAR"), entryLines(kStar));  // the stored title comes back
    EXPECT_EQ(findEntry(text, "\xE9T\xC9")->title, "\xC9t\xE9");
    // The markers after the title line compare exactly: the entry's own fields, in order.
    EXPECT_EQ(found("<|?A\r\n<|'t\r\n<||\r\n<|*<|\r\n", "a"), "<|?A\r\n<|'t\r\n<||\r\n<|*<|\r\n");
    EXPECT_EQ(found("<|?A\r\n<|'t\r\n", "A"), "none");  // a torn entry is no entry
}

TEST(Records, AppendReplaceAndRemoveKeepOtherEntries) {
    const std::vector<Entry> all = {kStar, kStarWars, kWars};
    const std::string text = entriesOf(all);
    EXPECT_EQ(appendEntry("", kStar), entryLines(kStar));
    // A text whose last line lacks its CR LF gets it before the new lines.
    EXPECT_EQ(appendEntry("<|?Star\r\n<|'CD\r\n<||1\r\n<|*first", kWars),
              entriesOf({kStar, kWars}));

    const Entry changed{"New Title", "Tape", "10", "changed"};
    for (std::size_t i = 0; i < all.size(); ++i) {
        SCOPED_TRACE(all[i].title);
        auto replaced = all, removed = all;
        replaced[i] = changed;
        removed.erase(removed.begin() + static_cast<std::ptrdiff_t>(i));
        EXPECT_EQ(replaceEntry(text, all[i].title, changed), entriesOf(replaced));
        EXPECT_EQ(removeEntry(text, all[i].title), entriesOf(removed));
    }
    EXPECT_EQ(removeEntry(entriesOf({kWars}), "WARS"), "");
    EXPECT_FALSE(replaceEntry(text, "Missing", changed));
    EXPECT_FALSE(removeEntry(text, "Star War"));
    // With two titles equal but for case, the first in file order is the one changed.
    const Entry upper{"STAR", "x", "y", "z"};
    EXPECT_EQ(removeEntry(entriesOf({kWars, kStar, upper}), "star"), entriesOf({kWars, upper}));
}

// Older files could store the title tag inside a value. Only a line that starts one of the
// four-line entries is a title line: finding, the duplicate test, replacing and removing never
// take a tag inside a value (at a line's end or at the start of a type line) for an entry.
TEST(Records, TitleTagsInsideValuesAreNoEntries) {
    const Entry a{"A", "<|?B", "1", "see <|?B"};
    const Entry b{"B", "CD", "2", "b"};
    const Entry c{"C", "LP", "3", "<|?C"};
    const std::string text = entriesOf({a, b, c});
    EXPECT_EQ(found(text, "b"), entryLines(b));
    EXPECT_EQ(found(text, "C"), entryLines(c));
    EXPECT_EQ(findTitleLine(entriesOf({a}), "B"), std::string::npos);
    EXPECT_EQ(findTitleLine(text, "C"), entriesOf({a, b}).size());
    const Entry changed{"N", "x", "y", "z"};
    EXPECT_EQ(replaceEntry(text, "A", changed), entriesOf({changed, b, c}));
    EXPECT_EQ(replaceEntry(text, "B", changed), entriesOf({a, changed, c}));
    EXPECT_EQ(removeEntry(text, "A"), entriesOf({b, c}));
    EXPECT_EQ(removeEntry(text, "C"), entriesOf({a, b}));
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

    EXPECT_EQ(renameArticleLine(articles, "STAR", "Moon"),
              "Best of Star#*\\B001\r\n\r\nMoon#*\\S001\r\nStar Wars#*\\S002\r\nWars#*\\W001\r\n");
    EXPECT_FALSE(renameArticleLine(articles, "of Star", "X"));
    // Removing keeps the empty line and the order of the rest.
    EXPECT_EQ(removeArticleLine(articles, "Star"),
              "Best of Star#*\\B001\r\n\r\nStar Wars#*\\S002\r\nWars#*\\W001\r\n");
    EXPECT_EQ(removeArticleLine(articles, "Wars"),
              "Best of Star#*\\B001\r\n\r\nstar#*\\S001\r\nStar Wars#*\\S002\r\n");
    EXPECT_EQ(removeArticleLine(articles, "Best of Star"),
              "\r\nstar#*\\S001\r\nStar Wars#*\\S002\r\nWars#*\\W001\r\n");
    EXPECT_EQ(removeArticleLine(articles, "ars"), articles);
}

TEST(Records, RemoveIndexLineTakesTheWholeLineIgnoringCase) {
    const std::string index = "Rock and Pop\r\nPOP\r\n\r\nPop\r\nJazz\r\n";
    EXPECT_EQ(removeIndexLine(index, "pop"), "Rock and Pop\r\n\r\nPop\r\nJazz\r\n");
    EXPECT_EQ(removeIndexLine(index, "JAZZ"), "Rock and Pop\r\nPOP\r\n\r\nPop\r\n");
    EXPECT_EQ(removeIndexLine(index, "Rock"), index);
    EXPECT_EQ(removeIndexLine(index, "and"), index);
    EXPECT_EQ(removeIndexLine("a\nPop\r\n", "Pop"), "a\nPop\r\n");  // one line "a\nPop"
}

}  // namespace
}  // namespace catalogue
