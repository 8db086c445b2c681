// Opening a list, selecting an entry, the combo boxes' typing limits and "Reset".
#include "tests/main_window/form1_test_fixture.h"

namespace main_window_test {
namespace {

TEST_F(Form1Test, OpeningReadsTheListAndShowsItsTitlesSortedAndTheAmount) {
    std::vector<Item> twelve;
    for (int i = 12; i >= 1; --i) twelve.push_back({"Title " + std::to_string(i), "CD", "1", ""});
    putRock();
    putList("Twelve", entries(twelve), "");
    putList("Empty", "", "");
    folder.put("pemla.dat", crlf({"Rock", "Twelve", "Empty"}));
    start();

    open("Rock");
    EXPECT_EQ(titles(), (Strings{"1st", "abc", "abcd", "xabc", "Zebra"}));
    EXPECT_EQ(view.Label2.caption(), "... amount:  5 ...");
    EXPECT_EQ(form->ListText, entries(rock));
    EXPECT_EQ(platform.busyCount(), 1);
    EXPECT_EQ(platform.busyDepth(), 0);
    expectReset();

    open("Twelve");
    EXPECT_EQ(view.Label2.caption(), "... amount:  12 ...");
    EXPECT_EQ(titles().front(), "Title 1");
    EXPECT_EQ(titles().back(), "Title 9");

    open("Empty");
    EXPECT_TRUE(titles().empty());
    EXPECT_EQ(view.Label2.caption(), "... amount:  0 ...");

    // Selecting a list again reads it again.
    std::vector<Item> more = rock;
    more.push_back({"Blues", "CD", "1", ""});
    folder.put("Rock.dat", entries(more));
    open("Rock");
    EXPECT_EQ(titles(), (Strings{"1st", "abc", "abcd", "Blues", "xabc", "Zebra"}));
    EXPECT_EQ(view.Label2.caption(), "... amount:  6 ...");
    EXPECT_TRUE(platform.shown().empty());
}

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
        putList(c.list, kSkeletonDat, kSkeletonArt, "A#001\r\n", c.flag);
        index.push_back(c.list);
    }
    folder.put("pemla.dat", crlf(index));
    start();
    // Opened in this order, each list also shows that the previous one's set-up is undone.
    for (const auto& c : cases) {
        SCOPED_TRACE(c.list);
        open(c.list);
        EXPECT_EQ(view.Text1.maxLength(), c.maxLength);
        EXPECT_EQ(view.Combo3.isEnabled(), c.information);
        EXPECT_EQ(view.Combo3.text(), c.information ? "Info" : "  ");
        view.Text1.type(std::string(50, 'x'));
        EXPECT_EQ(view.Text1.text().size(), static_cast<std::size_t>(c.maxLength));
        // "Reset" shows "Info" but leaves the box as the list set it up.
        view.Command_clear.click();
        EXPECT_EQ(view.Combo3.text(), "Info");
        EXPECT_EQ(view.Combo3.isEnabled(), c.information);
    }
    EXPECT_TRUE(platform.shown().empty());
}

TEST_F(Form1Test, AListThatCannotBeReadWholeIsNamedAndNeverWritten) {
    putRock({"Cut", "Gone"});
    folder.put("Cut.dat", entries(rock) + "<|?Half\r\n<|'CD\r\n");
    std::filesystem::remove(folder.file("Gone.dat"));
    start();
    for (const std::string list : {"Cut", "Gone"}) {
        SCOPED_TRACE(list);
        // A list opened whole first, so ListText holds another list's text.
        open("Rock");
        const Files before = snapshot();
        const std::size_t boxes = platform.shown().size();
        platform.answer(Answer::Ok);
        open(list);
        expectBox(boxes, 16, "Error");
        EXPECT_NE(platform.shown().back().prompt.find("\"" + list + ".dat\""), std::string::npos)
            << platform.shown().back().prompt;
        EXPECT_TRUE(titles().empty());

        fill({"New title", "CD", "1", "Copy"});
        platform.answer(Answer::Ok);
        view.Command_add.click();
        expectBox(boxes + 1, 16, "Error");
        platform.answer(Answer::Ok);
        view.Command_change.click();
        expectBox(boxes + 2, 16, "Error");
        view.Command_delentry.click();
        EXPECT_EQ(platform.shown().size(), boxes + 3);
        EXPECT_EQ(snapshot(), before);
    }
}

TEST_F(Form1Test, SelectingAnEntryFillsTheFieldsAndReadsItsArticleNumber) {
    startWithRock();
    const struct {
        const char* title;
        const char* fields;
    } cases[] = {
        // abcd stands before abc in both files and xabc ends with abc: each finds its own.
        {"abc", "abc|Game|3||A002"},       {"abcd", "abcd|DVD|2|Copy|A001"},
        {"xabc", "xabc|CD|10|x|X001"},     {"Zebra", "Zebra|CD|1|Original|Z001"},
        {"1st", "1st|LP|1|Original|!001"},
    };
    for (const auto& c : cases) {
        select(c.title);
        EXPECT_EQ(fields(), c.fields);
    }
    EXPECT_EQ(platform.busyDepth(), 0);
    EXPECT_GE(view.List_list.refreshCount(), 5);

    // The article file is read at every selection; a title without a line shows no number.
    folder.put("Rock.art", articles({{"xabc", "X001"}, {"ABC", "B123"}}));
    select("abcd");
    EXPECT_EQ(fields(), "abcd|DVD|2|Copy|");
    select("abc");
    EXPECT_EQ(fields(), "abc|Game|3||B123");
    EXPECT_TRUE(platform.shown().empty());
}

TEST_F(Form1Test, CombosLimitTypingToTheirOwnTextButAlwaysTakeBackspace) {
    start();
    const struct {
        ui::memory::MemoryComboBox* box;
        std::size_t limit;
    } cases[] = {{&view.Combo1, 17}, {&view.Combo2, 6}, {&view.Combo3, 16}};
    // Each box is filled up before the next is typed into: a full box limits only itself.
    for (const auto& c : cases) {
        SCOPED_TRACE(c.limit);
        retype(*c.box, "");
        EXPECT_EQ(c.box->text(), "");
        c.box->type(std::string(30, 'x'));
        EXPECT_EQ(c.box->text(), std::string(c.limit, 'x'));
        c.box->type("\b");
        EXPECT_EQ(c.box->text().size(), c.limit - 1);
        c.box->type("yz");
        EXPECT_EQ(c.box->text(), std::string(c.limit - 1, 'x') + "y");
    }
}

TEST_F(Form1Test, SelectionShowsStoredValuesUncutAndTheFirstOfTitlesEqualApartFromCase) {
    const std::string type20 = "Twenty characters!!!";
    putList("Odd",
            entries({{"ROCK", "upper", "1", "a"},
                     {"rock", "lower", "2", "b"},
                     {"Long", type20, "1234567", "an information of 20"}}),
            articles({{"ROCK", "R001"}, {"rock", "R002"}, {"Long", "L001"}}));
    folder.put("pemla.dat", crlf({"Odd"}));
    start();
    open("Odd");
    EXPECT_EQ(titles(), (Strings{"Long", "ROCK", "rock"}));
    select("rock");
    EXPECT_EQ(fields(), "rock|upper|1|a|R001");

    select("Long");
    EXPECT_EQ(fields(), "Long|" + type20 + "|1234567|an information of 20|L001");
    view.Combo1.type("a");
    EXPECT_EQ(view.Combo1.text(), type20);
    view.Combo1.type("\ba");
    EXPECT_EQ(view.Combo1.text(), type20.substr(0, 19));
    view.Combo2.type("\b\b67");
    EXPECT_EQ(view.Combo2.text(), "123456");
}

TEST_F(Form1Test, ResetClearsTheFieldsAndTheSelection) {
    startWithRock();
    select("abcd");
    view.Combo1.type("xyz");
    view.Command_clear.click();
    expectReset();
    EXPECT_EQ(titles().size(), 5u);
}

}  // namespace
}  // namespace main_window_test
