#include "catalogue/records.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <string>
#include <vector>

#include "catalogue/file_text.h"

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

void expectEntry(const std::optional<Entry>& found, const Entry& want) {
    ASSERT_TRUE(found.has_value()) << want.title;
    EXPECT_EQ(found->title, want.title);
    EXPECT_EQ(found->type, want.type);
    EXPECT_EQ(found->discs, want.discs);
    EXPECT_EQ(found->information, want.information);
}

// Well-formed entry text: ends with one CR LF, no empty line, four lines per entry.
void expectWellFormed(const std::string& text) {
    EXPECT_TRUE(text.ends_with("\r\n")) << text;
    EXPECT_FALSE(text.ends_with("\r\n\r\n")) << text;
    const auto lines = splitLines(text);
    EXPECT_EQ(lines.size() % 4, 0u);
    for (std::string_view line : lines) EXPECT_FALSE(line.empty()) << text;
}

TEST(Records, FileNamesOfAList) {
    EXPECT_EQ(entryFile("Add one & delete me!"), "Add one & delete me!.dat");
    EXPECT_EQ(articleFile("Rock"), "Rock.art");
    EXPECT_EQ(counterFile("Rock"), "Rock.arn");
    EXPECT_EQ(flagFile("Rock"), "Rock.inf");
}

TEST(Records, FindEntryByTitleInAnyFileOrder) {
    std::vector<Entry> all = {kStar, kStarWars, kWars};
    std::sort(all.begin(), all.end(), [](auto& a, auto& b) { return a.title < b.title; });
    do {
        const std::string text = entriesOf(all);
        for (const Entry& e : all) expectEntry(findEntry(text, e.title), e);
        EXPECT_FALSE(findEntry(text, "Sta"));
        EXPECT_FALSE(findEntry(text, "ar Wars"));
    } while (std::next_permutation(all.begin(), all.end(),
                                   [](auto& a, auto& b) { return a.title < b.title; }));

    const std::string text = entriesOf({kStar, {"\xC9t\xE9", "CD", "1", "x"}});
    expectEntry(findEntry(text, "STAR"), kStar);  // the stored title comes back
    EXPECT_EQ(findEntry(text, "\xE9T\xC9")->title, "\xC9t\xE9");
    EXPECT_EQ(findTitleLine(text, "star"), 0u);
    // The markers after the title line compare exactly: the entry's own fields, in order.
    expectEntry(findEntry("<|?A\r\n<|'t\r\n<||\r\n<|*<|\r\n", "a"), {"A", "t", "", "<|"});
    EXPECT_FALSE(findEntry("<|?A\r\n<|'t\r\n", "A"));  // a torn entry is no entry
    EXPECT_FALSE(findEntry("", "A"));
}

TEST(Records, AppendReplaceAndRemoveKeepOtherEntries) {
    const std::vector<Entry> all = {kStar, kStarWars, kWars};
    const std::string text = entriesOf(all);
    EXPECT_EQ(appendEntry("", kStar), entryLines(kStar));
    EXPECT_EQ(appendEntry(entriesOf({kStar}), kWars), entriesOf({kStar, kWars}));
    // A text whose last line lacks its CR LF gets it before the new lines.
    EXPECT_EQ(appendEntry("<|?Star\r\n<|'CD\r\n<||1\r\n<|*first", kWars),
              entriesOf({kStar, kWars}));

    const Entry changed{"New Title", "Tape", "10", "changed"};
    for (std::size_t i = 0; i < all.size(); ++i) {
        SCOPED_TRACE(all[i].title);
        auto replaced = all, removed = all;
        replaced[i] = changed;
        removed.erase(removed.begin() + static_cast<std::ptrdiff_t>(i));

        auto r = replaceEntry(text, all[i].title, changed);
        ASSERT_TRUE(r);
        EXPECT_EQ(*r, entriesOf(replaced));
        expectWellFormed(*r);

        auto d = removeEntry(text, all[i].title);
        ASSERT_TRUE(d);
        EXPECT_EQ(*d, entriesOf(removed));
        expectWellFormed(*d);
    }
    EXPECT_EQ(removeEntry(entriesOf({kWars}), "WARS"), "");
    EXPECT_FALSE(replaceEntry(text, "Missing", changed));
    EXPECT_FALSE(removeEntry(text, "Star War"));
    // With two titles equal but for case, the first in file order is the one changed.
    const Entry upper{"STAR", "x", "y", "z"};
    EXPECT_EQ(removeEntry(entriesOf({kWars, kStar, upper}), "star"), entriesOf({kWars, upper}));
}

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
    EXPECT_EQ(articleLine("Star", "S001"), "Star#*\\S001\r\n");
    // A lone LF is data of its line: "x\nWars" is one title, not a line "Wars".
    EXPECT_EQ(findArticleNumber("x\nWars#*\\W001\r\n", "Wars"), std::nullopt);
    EXPECT_EQ(findArticleNumber("x\nWars#*\\W001\r\n", "x\nWars"), "W001");

    EXPECT_EQ(renameArticleLine(articles, "STAR", "Moon"),
              "Best of Star#*\\B001\r\n\r\nMoon#*\\S001\r\nStar Wars#*\\S002\r\nWars#*\\W001\r\n");
    EXPECT_EQ(renameArticleLine(articles, "Star Wars", "X"),
              "Best of Star#*\\B001\r\n\r\nstar#*\\S001\r\nX#*\\S002\r\nWars#*\\W001\r\n");
    EXPECT_FALSE(renameArticleLine(articles, "of Star", "X"));

    // Removing keeps the empty line and the order of the rest.
    EXPECT_EQ(removeArticleLine(articles, "Star"),
              "Best of Star#*\\B001\r\n\r\nStar Wars#*\\S002\r\nWars#*\\W001\r\n");
    EXPECT_EQ(removeArticleLine(articles, "Wars"),
              "Best of Star#*\\B001\r\n\r\nstar#*\\S001\r\nStar Wars#*\\S002\r\n");
    EXPECT_EQ(removeArticleLine(articles, "Best of Star"),
              "\r\nstar#*\\S001\r\nStar Wars#*\\S002\r\nWars#*\\W001\r\n");
    EXPECT_EQ(removeArticleLine(articles, "Moon"), articles);
    EXPECT_EQ(removeArticleLine(articles, "ars"), articles);
}

TEST(Records, RemoveIndexLineTakesTheWholeLineIgnoringCase) {
    const std::string index = "Rock and Pop\r\nPOP\r\n\r\nPop\r\nJazz\r\n";
    EXPECT_EQ(removeIndexLine(index, "pop"), "Rock and Pop\r\n\r\nPop\r\nJazz\r\n");
    EXPECT_EQ(removeIndexLine(index, "JAZZ"), "Rock and Pop\r\nPOP\r\n\r\nPop\r\n");
    EXPECT_EQ(removeIndexLine(index, "Rock"), index);
    EXPECT_EQ(removeIndexLine(index, "and"), index);
    EXPECT_EQ(removeIndexLine("Add one & delete me!\r\n", "add one & DELETE me!"), "");
    EXPECT_EQ(removeIndexLine("a\nPop\r\n", "Pop"), "a\nPop\r\n");  // one line "a\nPop"
}

TEST(Records, ValueProblem) {
    EXPECT_EQ(valueProblem("Star Wars: Episode IV (1977) & more", true), "");
    EXPECT_EQ(valueProblem("", false), "");
    EXPECT_EQ(valueProblem("a#*\\b", false), "");  // only a title precedes the separator
    for (std::string_view bad : {"a\rb", "a\nb", "x<|?", "<|'", "a<||b", "<|*"}) {
        EXPECT_NE(valueProblem(bad, true), "") << bad;
        EXPECT_NE(valueProblem(bad, false), "") << bad;
    }
    EXPECT_NE(valueProblem("a#*\\b", true), "");
}

}  // namespace
}  // namespace catalogue
