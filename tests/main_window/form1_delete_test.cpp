// The confirmations, "Delete entry" and "Delete list": what leaves the files, and the
// placeholders that keep a list and the catalogue from becoming empty.
#include "tests/main_window/form1_test_fixture.h"

namespace main_window_test {
namespace {

constexpr const char* kDeleteList = "ARE YA SURE YA WANT TO DELETE THE SELECTED LIST?";

TEST_F(Form1Test, AnsweredNoOrWithNothingSelectedNothingChanges) {
    putRock({"Jazz"});
    start();
    const Files before = snapshot();
    view.Command_delete.click();
    open("Rock");
    view.Command_delentry.click();
    EXPECT_TRUE(platform.shown().empty());
    platform.answer(Answer::Ok);
    view.Command_change.click();
    expectBox(0, 16, "Error", "Select the entry to change in the list first.");

    select("abc");
    retype(view.Combo1, "LP");
    platform.answer(Answer::No);
    view.Command_change.click();
    expectBox(1, 4, "Change item", "Are ya sure yo want to change selected entry?");
    expectReset();

    select("abc");
    platform.answer(Answer::No);
    view.Command_delentry.click();
    expectBox(2, 260, "Change item", "Are ya sure yo want to DELETE selected entry?");
    EXPECT_EQ(fields(), "abc|Game|3||A002");

    platform.answer(Answer::No);
    view.Command_delete.click();
    expectBox(3, 260, "DELETE?", kDeleteList);
    platform.answer(Answer::Yes);
    platform.answer(Answer::No);
    view.Command_delete.click();
    EXPECT_EQ(platform.shown()[4].prompt, kDeleteList);
    expectBox(5, 308, "DELETE?", "ARE YA REALLY SURE?");

    EXPECT_EQ(snapshot(), before);
}

TEST_F(Form1Test, DeleteEntryRemovesItsLinesAndKeepsItsValuesInTheFields) {
    putRock({"Jazz"});
    start();
    // The first entry of the file, a middle one with abcd before it, and the last one.
    for (const std::size_t at : {0u, 2u, 4u}) {
        const std::string title = rock[at].title;
        SCOPED_TRACE(title);
        reopenRock();
        select(title);
        const std::string shown = fields();
        platform.answer(Answer::Yes);
        view.Command_delentry.click();

        std::vector<Item> expected = rock;
        expected.erase(expected.begin() + static_cast<std::ptrdiff_t>(at));
        std::vector<Art> art;
        for (const Art& a : rockArt) {
            if (a.title != title) art.push_back(a);
        }
        expectList("Rock", entries(expected), articles(art), rockArn);
        EXPECT_EQ(fields(), shown);
        EXPECT_EQ(view.List1.selectedIndex(), -1);
        EXPECT_EQ(titles().size(), 4u);
        EXPECT_EQ(view.Label2.caption(), "... amount:  4 ...");
    }
}

TEST_F(Form1Test, DeletingTheOnlyEntryWritesTheSkeletonAndRestartsNumbering) {
    putList("Solo", entries({{"Jazz Album", "CD", "2", "Copy"}}),
            articles({{"Jazz Album", "J001"}}), crlf({"A#004", "J#002"}), " 0 \r\n");
    putList("Skel", kSkeletonDat, kSkeletonArt);
    folder.put("pemla.dat", crlf({"Solo", "Skel"}));
    start();
    // A real entry, and the placeholder itself, which is written anew.
    for (const std::string list : {"Solo", "Skel"}) {
        SCOPED_TRACE(list);
        const std::string flag = folder.get(list + ".inf");
        open(list);
        select(titles().front());
        platform.answer(Answer::Yes);
        view.Command_delentry.click();
        expectList(list, kSkeletonDat, kSkeletonArt, "A#001\r\n");
        EXPECT_EQ(folder.get(list + ".inf"), flag);
        expectReset();
        EXPECT_EQ(view.Label2.caption(), "... amount:  1 ...");
        select("Add an item and delete me!");
        EXPECT_EQ(fields(), "Add an item and delete me!|DELETE ME!|DELETE ME!|DELETE ME!|A001");
    }
}

// "abc" lacks its counter and flag files: the rest goes all the same.
TEST_F(Form1Test, DeleteListRemovesItsFilesAndOnlyItsOwnIndexLine) {
    const Strings lists = {"xabc", "abcd", "abc", "Jazz"};
    for (const std::string& list : lists) putList(list, kSkeletonDat, kSkeletonArt);
    std::filesystem::remove(folder.file("abc.arn"));
    std::filesystem::remove(folder.file("abc.inf"));
    folder.put("pemla.dat", crlf(lists));
    start();
    open("abc");
    Files expected = snapshot();
    expected.erase("abc.dat");
    expected.erase("abc.art");
    expected["pemla.dat"] = crlf({"xabc", "abcd", "Jazz"});
    platform.answer(Answer::Yes);
    platform.answer(Answer::Yes);
    view.Command_delete.click();
    EXPECT_EQ(snapshot(), expected);
    EXPECT_EQ(view.List_list.items(), (Strings{"abcd", "Jazz", "xabc"}));
    EXPECT_EQ(view.List_list.selectedIndex(), -1);
    EXPECT_TRUE(titles().empty());

    // With no list open, "Add" says so, keeps what was typed and writes nothing.
    fill({"Orphan", "CD", "1", ""});
    platform.answer(Answer::Ok);
    view.Command_add.click();
    EXPECT_EQ(snapshot(), expected);
    EXPECT_EQ(fields(), "Orphan|CD|1||");
    expectBox(2, 16, "Error");
}

// The last list gives way to the placeholder list; the placeholder list itself, with an entry
// and no flag file as older copies left it, is renewed rather than lost.
TEST_F(Form1Test, DeletingTheOnlyListLeavesThePlaceholderList) {
    putRock();
    Files expected = snapshot();
    for (const char* ext : {".dat", ".art", ".arn", ".inf"})
        expected.erase(std::string("Rock") + ext);
    expected["pemla.dat"] = crlf({kPlaceholderList});
    expected[kPlaceholderList + ".dat"] = kSkeletonDat;
    expected[kPlaceholderList + ".art"] = kSkeletonArt;
    expected[kPlaceholderList + ".arn"] = "A#001\r\n";
    expected[kPlaceholderList + ".inf"] = " 1 \r\n";
    start();
    for (const std::string& list : {std::string("Rock"), kPlaceholderList}) {
        SCOPED_TRACE(list);
        open(list);
        platform.answer(Answer::Yes);
        platform.answer(Answer::Yes);
        view.Command_delete.click();
        EXPECT_EQ(snapshot(), expected);
        EXPECT_EQ(view.List_list.items(), (Strings{kPlaceholderList}));
        EXPECT_TRUE(titles().empty());
        open(kPlaceholderList);
        EXPECT_EQ(titles(), (Strings{"Add an item and delete me!"}));
        EXPECT_TRUE(view.Combo3.isEnabled());
        fill({"Mine", "CD", "1", ""});
        view.Command_add.click();
        std::filesystem::remove(folder.file(kPlaceholderList + ".inf"));
    }
    EXPECT_EQ(platform.shown().size(), 4u);
}

}  // namespace
}  // namespace main_window_test
