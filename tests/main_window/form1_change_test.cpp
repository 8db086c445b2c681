// "Change": the confirmation, the entry kept in its place, and its article line and number.
#include <algorithm>

#include "tests/main_window/form1_test_fixture.h"

namespace main_window_test {
namespace {

constexpr const char* kConfirm = "Are ya sure yo want to change selected entry?";

TEST_F(Form1Test, ChangeAnsweredNoOrWithNoEntrySelectedWritesNothing) {
    startWithRock();
    const Files before = snapshot();
    fill({"Other", "CD", "1", ""});
    platform.answer(Answer::Ok);
    view.Command_change.click();
    expectBox(0, 16, "Error");

    select("abc");
    retype(view.Combo1, "LP");
    platform.answer(Answer::No);
    view.Command_change.click();
    expectBox(1, 4, "Change item", kConfirm);
    expectReset();
    EXPECT_EQ(snapshot(), before);
}

TEST_F(Form1Test, ChangingOtherFieldsKeepsTheEntrysPlaceAndLeavesTheNumbersAlone) {
    putRock({"Jazz"});
    start();
    // The first, a middle and the last entry of the file.
    for (const std::size_t at : {0u, 2u, 4u}) {
        SCOPED_TRACE(rock[at].title);
        reopenRock();
        const ino_t art = inode("Rock.art");
        const ino_t arn = inode("Rock.arn");
        select(rock[at].title);
        retype(view.Combo1, "Vinyl");
        retype(view.Combo2, "4");
        retype(view.Combo3, "Signed");
        platform.answer(Answer::Yes);
        view.Command_change.click();
        std::vector<Item> expected = rock;
        expected[at] = {rock[at].title, "Vinyl", "4", "Signed"};
        expectFile("Rock.dat", entries(expected));
        expectFile("Rock.art", articles(rockArt));
        expectFile("Rock.arn", rockArn);
        EXPECT_EQ(inode("Rock.art"), art);
        EXPECT_EQ(inode("Rock.arn"), arn);
        EXPECT_EQ(form->ListText, entries(expected));
        EXPECT_EQ(view.Label2.caption(), "... amount:  5 ...");
        expectReset();
    }
}

TEST_F(Form1Test, ChangingTheTitleKeepsOrRenewsItsArticleNumberByItsFirstLetter) {
    const struct {
        std::string from, to;
        std::string number;  // empty: the number and the line's place are kept
        Strings counter;     // empty: the counter file is not rewritten
    } cases[] = {
        {"abc", "ABC", "", {}},  // only the case changes
        {"abcd", "alpha", "", {}},
        {"Zebra", "zoo", "", {}},
        {"abc", "Quartz", "Q001", {"A#003", "Z#002", "X#002", "!#002", "Q#002"}},
        {"xabc", "Yak", "Y001", {"A#003", "Z#002", "X#002", "!#002", "Y#002"}},
        {"abcd", "Babcd", "B001", {"A#003", "Z#002", "X#002", "!#002", "B#002"}},
        // Two digits file under the same letter, but the first character changed.
        {"1st", "2nd", "!002", {"A#003", "Z#002", "X#002", "!#003"}},
    };
    putRock({"Jazz"});
    start();
    for (const auto& c : cases) {
        SCOPED_TRACE(c.from + " -> " + c.to);
        reopenRock();
        const ino_t arn = inode("Rock.arn");
        select(c.from);
        retype(view.Text1, c.to);
        platform.answer(Answer::Yes);
        view.Command_change.click();

        std::vector<Item> expected = rock;
        for (Item& e : expected) {
            if (e.title == c.from) e.title = c.to;
        }
        expectFile("Rock.dat", entries(expected));
        std::vector<Art> art;
        for (const Art& a : rockArt) {
            if (a.title != c.from) {
                art.push_back(a);
            } else if (c.number.empty()) {
                art.push_back({c.to, a.number});
            }
        }
        if (!c.number.empty()) art.push_back({c.to, c.number});
        expectFile("Rock.art", articles(art));
        if (c.counter.empty()) {
            expectFile("Rock.arn", rockArn);
            EXPECT_EQ(inode("Rock.arn"), arn);
        } else {
            expectFile("Rock.arn", crlf(c.counter));
        }
        const Strings shown = titles();
        EXPECT_NE(std::find(shown.begin(), shown.end(), c.to), shown.end());
        expectReset();
        ASSERT_FALSE(platform.shown().empty());
        EXPECT_EQ(platform.shown().back().style, 4);
    }
}

TEST_F(Form1Test, ChangingATitleWithoutAnArticleLineGivesItAFreshOne) {
    putRock();
    std::vector<Art> art = rockArt;
    art.pop_back();  // abc's line
    folder.put("Rock.art", articles(art));
    start();
    open("Rock");
    select("abc");
    EXPECT_EQ(view.Textart.text(), "");
    retype(view.Combo1, "Vinyl");
    platform.answer(Answer::Yes);
    view.Command_change.click();
    art.push_back({"abc", "A003"});
    expectFile("Rock.art", articles(art));
    expectFile("Rock.arn", crlf({"A#004", "Z#002", "X#002", "!#002"}));
    std::vector<Item> expected = rock;
    expected[2].type = "Vinyl";
    expectFile("Rock.dat", entries(expected));
}

}  // namespace
}  // namespace main_window_test
