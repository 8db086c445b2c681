// "Change": the entry kept in its place, and its article line and number.
#include <algorithm>

#include "tests/main_window/form1_test_fixture.h"

namespace main_window_test {
namespace {

TEST_F(Form1Test, ChangeKeepsTheEntrysPlaceAndKeepsOrRenewsItsNumberByItsFirstLetter) {
    const struct {
        std::string from, to;
        std::string number;  // empty: the number and the line's place are kept
        Strings counter;     // empty: the counter file is left as it was
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
    putRock({"Jazz"});
    start();
    for (const auto& c : cases) {
        SCOPED_TRACE(c.from + " -> " + c.to);
        reopenRock();
        select(c.from);
        fill({c.to, "Vinyl", "4", "Signed"});
        platform.answer(Answer::Yes);
        view.Command_change.click();

        std::vector<Item> expected = rock;
        std::vector<Art> art;
        for (Item& e : expected) {
            if (e.title == c.from) e = {c.to, "Vinyl", "4", "Signed"};
        }
        for (const Art& a : rockArt) {
            if (a.title != c.from) {
                art.push_back(a);
            } else if (c.number.empty()) {
                art.push_back({c.to, a.number});
            }
        }
        if (!c.number.empty()) art.push_back({c.to, c.number});
        expectList("Rock", entries(expected), articles(art),
                   c.counter.empty() ? rockArn : crlf(c.counter));
        const Strings shown = titles();
        EXPECT_NE(std::find(shown.begin(), shown.end(), c.to), shown.end());
        EXPECT_EQ(view.Label2.caption(), "... amount:  5 ...");
        expectReset();
    }
}

// A change that keeps the title leaves the article file alone, so it does not need one.
TEST_F(Form1Test, AChangeThatKeepsTheTitleWorksWithoutTheArticleFile) {
    startWithRock();
    select("Zebra");
    std::filesystem::remove(folder.file("Rock.art"));
    fill({"Zebra", "Vinyl", "4", "Signed"});
    platform.answer(Answer::Yes);
    view.Command_change.click();
    std::vector<Item> expected = rock;
    expected.front() = {"Zebra", "Vinyl", "4", "Signed"};
    EXPECT_EQ(folder.get("Rock.dat"), entries(expected));
    EXPECT_FALSE(folder.has("Rock.art"));
    expectReset();
}

}  // namespace
}  // namespace main_window_test
