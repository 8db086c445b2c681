// "Add": the duplicate test, the files written, article numbers, and the refusals.
#include "tests/main_window/form1_test_fixture.h"

namespace main_window_test {
namespace {

// Titles that begin or end another are no duplicates, and one space may stand twice.
TEST_F(Form1Test, AddAppendsTheEntryAndItsArticleLineAndResetsTheFields) {
    startWithRock();
    fill({"Blues", "Music CD", "2", "Copy"});
    view.Command_add.click();
    EXPECT_EQ(titles(), (Strings{"1st", "abc", "abcd", "Blues", "xabc", "Zebra"}));
    EXPECT_EQ(view.Label2.caption(), "... amount:  6 ...");
    expectReset();
    EXPECT_TRUE(view.Text1.hasFocus());

    std::vector<Item> expected = rock;
    expected.push_back({"Blues", "Music CD", "2", "Copy"});
    for (const std::string title : {"ab", "abcde", "bc", " ", " ", "\351clair", "[x]"}) {
        fill({title, "CD", "1", ""});
        view.Command_add.click();
        expected.push_back({title, "CD", "1", ""});
    }
    EXPECT_TRUE(platform.shown().empty());
    expectList("Rock", entries(expected),
               articles(rockArt) + articles({{"Blues", "B001"},
                                             {"ab", "A003"},
                                             {"abcde", "A004"},
                                             {"bc", "B002"},
                                             {" ", "!002"},
                                             {" ", "!003"},
                                             {"\351clair", "!004"},
                                             {"[x]", "!005"}}),
               crlf({"A#005", "Z#002", "X#002", "!#006", "B#003"}));
    EXPECT_EQ(view.Label2.caption(), "... amount:  13 ...");
}

// The placeholder holds A001 without having counted it, so the first A-title gets A001 too.
TEST_F(Form1Test, AddToThePlaceholderListStartsEachLetterAtOne) {
    putList("New", kSkeletonDat, kSkeletonArt);
    folder.put("pemla.dat", crlf({"New"}));
    start();
    open("New");
    std::vector<Item> expected;
    for (const std::string title : {"apple", "Avocado", "banana"}) {
        fill({title, "CD", "1", "Info"});
        view.Command_add.click();
        expected.push_back({title, "CD", "1", "Info"});
    }
    expectList(
        "New", kSkeletonDat + entries(expected),
        kSkeletonArt + articles({{"apple", "A001"}, {"Avocado", "A002"}, {"banana", "B001"}}),
        crlf({"A#003", "B#002"}));
}

TEST_F(Form1Test, AddRefusesDuplicatesAndValuesThatWouldBreakTheFilesAndWritesNothing) {
    startWithRock();
    const std::string marks = ": the list's files use it to mark their records.";
    std::vector<std::pair<Item, std::string>> cases = {
        {{"", "CD", "1", "Copy"}, "Please type a title first."},
        {{"Dots#*\\here", "CD", "1", "Copy"}, "The title cannot hold \"#*\\\"" + marks},
        {{"Line\nbreak", "CD", "1", "Copy"}, "The title cannot hold a line break" + marks},
        {{"Title", "CD", "1", "a\rb"}, "The information cannot hold a line break" + marks},
    };
    for (const std::string tag : {"<|?", "<|'", "<||", "<|*"}) {
        const std::string holds = " cannot hold \"" + tag + "\"" + marks;
        cases.push_back({{"a" + tag + "b", "CD", "1", "Copy"}, "The title" + holds});
        cases.push_back({{"Title", "a" + tag, "1", "Copy"}, "The type" + holds});
        cases.push_back({{"Title", "CD", tag, "Copy"}, "The number of discs" + holds});
        cases.push_back({{"Title", "CD", "1", tag + "b"}, "The information" + holds});
    }
    // The duplicate test ignores case and looks at whole titles only.
    for (const std::string title : {"ABC", "zebra", "XABC", "1ST"}) {
        cases.push_back(
            {{title, "CD", "1", "Copy"}, "Title already exist, change name and try again!"});
    }
    const Files before = snapshot();
    for (const auto& [c, prompt] : cases) {
        SCOPED_TRACE(c.title + "|" + c.type + "|" + c.discs + "|" + c.info);
        const std::size_t boxes = platform.shown().size();
        fill(c);
        platform.answer(Answer::Ok);
        view.Command_add.click();
        expectBox(boxes, 16, "Error", prompt);
        EXPECT_EQ(fields(), c.title + "|" + c.type + "|" + c.discs + "|" + c.info + "|");
        EXPECT_TRUE(view.Text1.hasFocus());
    }
    EXPECT_EQ(snapshot(), before);

    // The separator only matters in the title, and the window still works.
    fill({"Fine", "a#*\\b", "1", "#*\\"});
    view.Command_add.click();
    EXPECT_EQ(titles().size(), 6u);
}

TEST_F(Form1Test, ALettersNumbersEndAt999AndNothingIsWrittenAfter) {
    putList("Full", entries({{"Bass", "CD", "1", ""}}), articles({{"Bass", "B004"}}),
            crlf({"A#999", "B#005"}));
    folder.put("pemla.dat", crlf({"Full"}));
    start();
    open("Full");
    fill({"Amber", "CD", "1", ""});
    view.Command_add.click();
    EXPECT_TRUE(platform.shown().empty());
    // "000" stands for a letter whose numbers are all handed out.
    expectList("Full", entries({{"Bass", "CD", "1", ""}, {"Amber", "CD", "1", ""}}),
               articles({{"Bass", "B004"}, {"Amber", "A999"}}), crlf({"A#000", "B#005"}));

    const std::string usedUp =
        "Every article number of the letter A (A001 to A999) has been handed out in this list, "
        "so no other title that files under this letter can be stored in it.";
    const Files before = snapshot();
    fill({"apple", "CD", "1", ""});
    platform.answer(Answer::Ok);
    view.Command_add.click();
    expectBox(0, 16, "Error", usedUp);
    EXPECT_EQ(view.Text1.text(), "apple");
    // Nor can a change give an entry a new A-number.
    select("Bass");
    retype(view.Text1, "Aqua");
    platform.answer(Answer::Yes);
    platform.answer(Answer::Ok);
    view.Command_change.click();
    expectBox(2, 16, "Error", usedUp);
    EXPECT_EQ(snapshot(), before);

    // Other letters go on.
    fill({"Bongo", "CD", "1", ""});
    view.Command_add.click();
    EXPECT_EQ(folder.get("Full.arn"), crlf({"A#000", "B#006"}));
    EXPECT_EQ(folder.get("Full.art"),
              articles({{"Bass", "B004"}, {"Amber", "A999"}, {"Bongo", "B005"}}));
}

}  // namespace
}  // namespace main_window_test
