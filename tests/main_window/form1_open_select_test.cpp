// Opening a list, selecting an entry, the combo boxes' typing limits, "Reset" and finding a title
// as the user types.
#include "main_window/title_finder.h"
#include "tests/main_window/form1_test_fixture.h"

namespace main_window_test {
namespace {

TEST_F(Form1Test, TheInformationFlagSetsTheTitleLengthAndTheInformationBox) {
    const struct {
        const char* list;
        const char* flag;  // empty: no flag file, as lists made by older copies
        int maxLength;
        bool information;
    } cases[] = {{"Off", " 0 \r\n", 42, false},
                 {"On", " 1 \r\n", 26, true},
                 {"Odd", " 7 \r\n", 42, false},
                 {"NoFlag", "", 26, true}};
    Strings index;
    for (const auto& c : cases) {
        folder.putList(c.list, std::string(catalogue::kSkeletonEntries),
                       std::string(catalogue::kSkeletonArticles), "A#001\r\n", c.flag);
        index.push_back(c.list);
    }
    folder.put("pemla.dat", crlf(index));
    start();
    // Opened in this order, each list also shows that the previous one's set-up is undone.
    for (const auto& c : cases) {
        SCOPED_TRACE(c.list);
        open(c.list);
        EXPECT_EQ(view.Combo3.isEnabled(), c.information);
        EXPECT_EQ(view.Combo3.text(), c.information ? "Info" : "  ");
        EXPECT_EQ(view.Text1.maxLength(), c.maxLength);
        // "Reset" leaves the box as the list set it up.
        view.Command_clear.click();
        EXPECT_EQ(view.Combo3.isEnabled(), c.information);
    }
}

TEST_F(Form1Test, OpeningShowsTheTitlesSortedAndSelectingOneFillsTheFields) {
    startWithRock();
    EXPECT_EQ(titles(), (Strings{"1st", "abc", "abcd", "xabc", "Zebra"}));
    EXPECT_EQ(platform.busyCount, 1);
    // abcd stands before abc in both files and xabc ends with abc: each finds its own.
    for (const char* shown : {"abc|Game|3||A002", "abcd|DVD|2|Copy|A001", "xabc|CD|10|x|X001"}) {
        const std::string expected = shown;
        select(expected.substr(0, expected.find('|')));
        EXPECT_EQ(fields(), expected);
    }
    EXPECT_EQ(platform.busyDepth, 0);

    select("abc");
    view.Combo1.type("xyz");
    view.Command_clear.click();
    expectReset();

    // The article file is read at every selection; a number shows up to its line end, and a
    // title without a line shows none.
    folder.put("Rock.art", articleText({{"xabc", "X001"}, {"ABC", "B12"}}));
    select("abc");
    EXPECT_EQ(fields(), "abc|Game|3||B12");
    select("abcd");
    EXPECT_EQ(fields(), "abcd|DVD|2|Copy|");
}

TEST_F(Form1Test, TitlesEqualApartFromCaseShowTheFirstAndCombosLimitOnlyTyping) {
    const std::string type20 = "Twenty characters!!!";
    folder.putList("Odd",
                   entryText({{"ROCK", "upper", "1", "a"},
                              {"rock", "lower", "2", "b"},
                              {"Long", type20, "1234567", "an information of 20"}}),
                   articleText({{"ROCK", "R001"}, {"rock", "R002"}, {"Long", "L001"}}));
    folder.put("pemla.dat", crlf({"Odd"}));
    start();
    open("Odd");
    EXPECT_EQ(titles(), (Strings{"Long", "ROCK", "rock"}));
    select("rock");
    EXPECT_EQ(fields(), "rock|upper|1|a|R001");

    // Stored values longer than a box's limit are shown uncut; typing stops at the limit, and
    // a full box limits only itself. Backspace always passes.
    select("Long");
    EXPECT_EQ(fields(), "Long|" + type20 + "|1234567|an information of 20|L001");
    view.Combo1.type("a\ba");
    EXPECT_EQ(view.Combo1.text(), type20.substr(0, 19));
    const struct {
        ui::memory::MemoryComboBox* box;
        std::size_t limit;
    } cases[] = {{&view.Combo1, 17}, {&view.Combo2, 6}, {&view.Combo3, 16}};
    for (const auto& c : cases) {
        SCOPED_TRACE(c.limit);
        retype(*c.box, std::string(30, 'x'));
        EXPECT_EQ(c.box->text(), std::string(c.limit, 'x'));
        c.box->type("\byz");
        EXPECT_EQ(c.box->text(), std::string(c.limit - 1, 'x') + "y");
    }
}

// Find as you type in the title list.
TEST_F(Form1Test, FindSelectsMatchingTitlesInTurnAndNeverHidesOne) {
    // List1 order: Abba Gold, abba live, Blur, Crème Brûlée, CRÈME fraîche, Zappa.
    const std::string creme = "Cr\350me Br\373l\351e", fraiche = "CR\310ME fra\356che";
    std::string mix;
    for (const char* title :
         {"Zappa", "abba live", creme.c_str(), "Blur", fraiche.c_str(), "Abba Gold"}) {
        mix += entryText({{title, "CD", "1", ""}});
    }
    folder.putList("Mix", mix, "");
    folder.put("pemla.dat", crlf({"Mix"}));
    start();
    open("Mix");
    main_window::TitleFinder finder(*form);
    const int next = 1, previous = -1;
    const struct {
        std::string text;  // typed into the box; empty: a step
        int step;
        std::string selected;  // empty: no match, it beeps and the selection stays
    } steps[] = {
        {"ABBA", 0, "Abba Gold"},
        {"", next, "abba live"},
        {"", next, "Abba Gold"},  // wraps to the top
        {"cr\xC8me", 0, creme},   // accented capitals fold as the list sorts
        {"", next, fraiche},
        {"creme", 0, ""},  // an unaccented letter is another letter
        {"LUR", 0, "Blur"},
        {"", previous, "Blur"},  // the only match stays selected
        {"zz", 0, ""},
        {"", next, ""},
    };
    std::string shown;
    int beeps = 0;
    for (const auto& s : steps) {
        SCOPED_TRACE(s.text + " " + std::to_string(s.step));
        if (s.step == next) {
            finder.FindNext();
        } else if (s.step == previous) {
            finder.FindPrevious();
        } else {
            finder.Text_find_Change(s.text);
        }
        if (s.selected.empty()) ++beeps;
        if (!s.selected.empty()) shown = s.selected;
        EXPECT_EQ(view.Text1.text(), shown);
        EXPECT_EQ(platform.beeps, beeps);
        EXPECT_EQ(view.List1.count(), 6);
    }
}

}  // namespace
}  // namespace main_window_test
