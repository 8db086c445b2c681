// Find as you type in the main window's title list.
#include "main_window/title_finder.h"
#include "tests/main_window/form1_test_fixture.h"

namespace main_window_test {
namespace {

TEST_F(Form1Test, FindSelectsMatchingTitlesInTurnAndNeverHidesOne) {
    // List1 order: Abba Gold, abba live, Blur, Crème Brûlée, CRÈME fraîche, Zappa.
    const std::string creme =
        "Cr\xE8me Br\xFBl\xE9"
        "e";
    const std::string fraiche =
        "CR\xC8ME fra\xEE"
        "che";
    putList("Mix",
            entryText({{"Zappa", "CD", "1", "z"},
                       {"abba live", "LP", "2", "l"},
                       {creme, "DVD", "3", "c"},
                       {"Blur", "Game", "4", "b"},
                       {fraiche, "CD", "5", "f"},
                       {"Abba Gold", "CD", "6", "g"}}),
            articleText({{"Zappa", "Z001"},
                         {"abba live", "A001"},
                         {creme, "!001"},
                         {"Blur", "B001"},
                         {fraiche, "!002"},
                         {"Abba Gold", "A002"}}));
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
        {"ABBA", 0, "Abba Gold|CD|6|g|A002"},
        {"", next, "abba live|LP|2|l|A001"},
        {"", next, "Abba Gold|CD|6|g|A002"},       // wraps to the top
        {"", previous, "abba live|LP|2|l|A001"},   // and to the bottom
        {"cr\xC8me", 0, creme + "|DVD|3|c|!001"},  // accented capitals fold as the list sorts
        {"", next, fraiche + "|CD|5|f|!002"},
        {"creme", 0, ""},  // an unaccented letter is another letter
        {"\xC8ME F", 0, fraiche + "|CD|5|f|!002"},
        {"LUR", 0, "Blur|Game|4|b|B001"},
        {"", previous, "Blur|Game|4|b|B001"},  // the only match stays selected
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
        EXPECT_EQ(fields(), shown);
        EXPECT_EQ(platform.beeps(), beeps);
        EXPECT_EQ(view.List1.count(), 6);
        EXPECT_EQ(view.Label2.caption(), "... amount:  6 ...");
    }
    EXPECT_TRUE(platform.shown().empty());
}

}  // namespace
}  // namespace main_window_test
