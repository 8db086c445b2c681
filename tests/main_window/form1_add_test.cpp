// "Add": the duplicate test, the files written, article numbers, and the refusals.
#include "tests/main_window/form1_test_fixture.h"

namespace main_window_test {
namespace {

constexpr const char* kDuplicate = "Title already exist, change name and try again!";

TEST_F(Form1Test, AddAppendsTheEntryAndItsArticleLineAndResetsTheFields) {
    startWithRock();
    fill({"Blues", "Music CD", "2", "Copy"});
    view.Command_add.click();
    std::vector<Item> expected = rock;
    expected.push_back({"Blues", "Music CD", "2", "Copy"});
    std::vector<Art> expectedArt = rockArt;
    expectedArt.push_back({"Blues", "B001"});
    expectFile("Rock.dat", entries(expected));
    expectFile("Rock.art", articles(expectedArt));
    expectFile("Rock.arn", rockArn + "B#002\r\n");
    expectFile("Rock.inf", " 1 \r\n");
    EXPECT_EQ(form->ListText, entries(expected));
    EXPECT_EQ(titles(), (Strings{"1st", "abc", "abcd", "Blues", "xabc", "Zebra"}));
    EXPECT_EQ(view.Label2.caption(), "... amount:  6 ...");
    expectReset();
    EXPECT_TRUE(view.Text1.hasFocus());
    EXPECT_TRUE(platform.shown().empty());
}

TEST_F(Form1Test, AddHandsOutArticleNumbersPerLetter) {
    putList("New", kSkeletonDat, kSkeletonArt);
    folder.put("pemla.dat", crlf({"New"}));
    start();
    open("New");
    // The placeholder holds A001 without having counted it, so the first A-title gets A001 too.
    const Strings added = {"apple", "Avocado", "banana", "2046", "\351clair", "Zz", "[x]"};
    for (const std::string& title : added) {
        fill({title, "CD", "1", "Info"});
        view.Command_add.click();
    }
    expectFile("New.art", kSkeletonArt + articles({{"apple", "A001"},
                                                   {"Avocado", "A002"},
                                                   {"banana", "B001"},
                                                   {"2046", "!001"},
                                                   {"\351clair", "!002"},
                                                   {"Zz", "Z001"},
                                                   {"[x]", "!003"}}));
    expectFile("New.arn", crlf({"A#003", "B#002", "!#004", "Z#002"}));
    std::vector<Item> expected;
    for (const std::string& title : added) expected.push_back({title, "CD", "1", "Info"});
    expectFile("New.dat", kSkeletonDat + entries(expected));
    EXPECT_EQ(view.Label2.caption(), "... amount:  8 ...");
    EXPECT_TRUE(platform.shown().empty());
}

TEST_F(Form1Test, AddStoresThePromptTextsOfAListWithoutInformation) {
    putList("Plain", kSkeletonDat, kSkeletonArt, "A#001\r\n", " 0 \r\n");
    folder.put("pemla.dat", crlf({"Plain"}));
    start();
    open("Plain");
    const std::string title42 = "A title of forty-two characters, no less!!";
    ASSERT_EQ(title42.size(), 42u);
    view.Text1.type(title42 + "more");
    view.Command_add.click();
    expectFile("Plain.dat", kSkeletonDat + entries({{title42, "Select type", "Disc(s)", "  "}}));
    expectFile("Plain.art", kSkeletonArt + articles({{title42, "A001"}}));
    // The next opening would set it up again; until then the box shows "Info", still disabled.
    EXPECT_EQ(view.Combo3.text(), "Info");
    EXPECT_FALSE(view.Combo3.isEnabled());
}

TEST_F(Form1Test, AddRefusesATitleTheListHasApartFromCase) {
    startWithRock();
    const Files before = snapshot();
    for (const std::string title : {"ABC", "zebra", "XABC", "1ST"}) {
        SCOPED_TRACE(title);
        const std::size_t boxes = platform.shown().size();
        fill({title, "CD", "1", "Copy"});
        platform.answer(Answer::Ok);
        view.Command_add.click();
        expectBox(boxes, 16, "Error", kDuplicate);
        EXPECT_EQ(fields(), title + "|CD|1|Copy|");
        EXPECT_TRUE(view.Text1.hasFocus());
    }
    EXPECT_EQ(snapshot(), before);
}

TEST_F(Form1Test, AddAcceptsTitlesThatBeginOrEndAnotherAndOneSpaceTwice) {
    startWithRock();
    const Strings added = {"ab", "abcde", "bc", " ", " "};
    for (const std::string& title : added) {
        fill({title, "CD", "1", ""});
        view.Command_add.click();
    }
    EXPECT_TRUE(platform.shown().empty());
    std::vector<Item> expected = rock;
    for (const std::string& title : added) expected.push_back({title, "CD", "1", ""});
    expectFile("Rock.dat", entries(expected));
    std::vector<Art> expectedArt = rockArt;
    expectedArt.insert(
        expectedArt.end(),
        {{"ab", "A003"}, {"abcde", "A004"}, {"bc", "B001"}, {" ", "!002"}, {" ", "!003"}});
    expectFile("Rock.art", articles(expectedArt));
    expectFile("Rock.arn", crlf({"A#005", "Z#002", "X#002", "!#004", "B#002"}));
    EXPECT_EQ(view.Label2.caption(), "... amount:  10 ...");
}

TEST_F(Form1Test, AddRefusesValuesThatWouldBreakTheFilesAndWritesNothing) {
    startWithRock();
    std::vector<Item> cases = {{"", "CD", "1", "Copy"}, {"Dots#*\\here", "CD", "1", "Copy"}};
    for (const std::string marker : {"<|?", "<|'", "<||", "<|*"}) {
        cases.push_back({"a" + marker + "b", "CD", "1", "Copy"});
        cases.push_back({"Title", "a" + marker, "1", "Copy"});
        cases.push_back({"Title", "CD", marker, "Copy"});
        cases.push_back({"Title", "CD", "1", marker + "b"});
    }
    const Files before = snapshot();
    for (const Item& c : cases) {
        SCOPED_TRACE(c.title + "|" + c.type + "|" + c.discs + "|" + c.info);
        const std::size_t boxes = platform.shown().size();
        fill(c);
        platform.answer(Answer::Ok);
        view.Command_add.click();
        expectBox(boxes, 16, "Error");
        EXPECT_EQ(fields(), c.title + "|" + c.type + "|" + c.discs + "|" + c.info + "|");
        EXPECT_EQ(form->ListText, entries(rock));
    }
    EXPECT_EQ(snapshot(), before);

    // The separator only matters in the title.
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
    expectFile("Full.art", articles({{"Bass", "B004"}, {"Amber", "A999"}}));
    // "000" stands for a letter whose numbers are all handed out.
    expectFile("Full.arn", crlf({"A#000", "B#005"}));

    const Files before = snapshot();
    fill({"apple", "CD", "1", ""});
    platform.answer(Answer::Ok);
    view.Command_add.click();
    expectBox(0, 16, "Error");
    EXPECT_EQ(snapshot(), before);
    EXPECT_EQ(view.Text1.text(), "apple");

    // Nor can a change give an entry a new A-number.
    select("Bass");
    retype(view.Text1, "Aqua");
    platform.answer(Answer::Yes);
    platform.answer(Answer::Ok);
    view.Command_change.click();
    expectBox(2, 16, "Error");
    EXPECT_EQ(snapshot(), before);

    // Other letters go on.
    fill({"Bongo", "CD", "1", ""});
    view.Command_add.click();
    expectFile("Full.arn", crlf({"A#000", "B#006"}));
    expectFile("Full.art", articles({{"Bass", "B004"}, {"Amber", "A999"}, {"Bongo", "B005"}}));
}

TEST_F(Form1Test, AMissingCounterFileIsNamedAndNothingIsWritten) {
    putRock();
    std::filesystem::remove(folder.file("Rock.arn"));
    start();
    open("Rock");
    const Files before = snapshot();
    fill({"Blues", "CD", "1", ""});
    platform.answer(Answer::Ok);
    view.Command_add.click();
    expectBox(0, 16, "Error");
    EXPECT_NE(platform.shown().back().prompt.find("Rock.arn"), std::string::npos);
    EXPECT_EQ(snapshot(), before);
    EXPECT_EQ(titles().size(), 5u);
}

}  // namespace
}  // namespace main_window_test
