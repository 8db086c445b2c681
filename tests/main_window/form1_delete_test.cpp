// "Delete entry" and "Delete list": confirmations, what leaves the files, and the placeholders
// that keep a list and the catalogue from becoming empty.
#include "tests/main_window/form1_test_fixture.h"

namespace main_window_test {
namespace {

constexpr const char* kDeleteEntry = "Are ya sure yo want to DELETE selected entry?";
constexpr const char* kDeleteList = "ARE YA SURE YA WANT TO DELETE THE SELECTED LIST?";
constexpr const char* kReallySure = "ARE YA REALLY SURE?";
const std::string kPlaceholderFields =
    "Add an item and delete me!|DELETE ME!|DELETE ME!|DELETE ME!|A001";

TEST_F(Form1Test, DeleteEntryAnsweredNoOrWithNothingSelectedChangesNothing) {
    startWithRock();
    const Files before = snapshot();
    view.Command_delentry.click();
    EXPECT_TRUE(platform.shown().empty());

    select("abc");
    platform.answer(Answer::No);
    view.Command_delentry.click();
    expectBox(0, 260, "Change item", kDeleteEntry);
    EXPECT_EQ(fields(), "abc|Game|3||A002");
    EXPECT_EQ(titles().size(), 5u);
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
        const ino_t arn = inode("Rock.arn");
        select(title);
        const std::string shown = fields();
        platform.answer(Answer::Yes);
        view.Command_delentry.click();

        std::vector<Item> expected = rock;
        expected.erase(expected.begin() + static_cast<std::ptrdiff_t>(at));
        expectFile("Rock.dat", entries(expected));
        std::vector<Art> art;
        for (const Art& a : rockArt) {
            if (a.title != title) art.push_back(a);
        }
        expectFile("Rock.art", articles(art));
        expectFile("Rock.arn", rockArn);
        EXPECT_EQ(inode("Rock.arn"), arn);
        EXPECT_EQ(fields(), shown);
        EXPECT_EQ(view.List1.selectedIndex(), -1);
        EXPECT_EQ(titles().size(), 4u);
        EXPECT_EQ(view.Label2.caption(), "... amount:  4 ...");
    }
}

TEST_F(Form1Test, DeletingAnEntryWithoutAnArticleLineStillDeletesIt) {
    putRock();
    std::vector<Art> art = rockArt;
    art.pop_back();  // abc's line
    folder.put("Rock.art", articles(art));
    start();
    open("Rock");
    select("abc");
    platform.answer(Answer::Yes);
    view.Command_delentry.click();
    std::vector<Item> expected = rock;
    expected.erase(expected.begin() + 2);
    expectFile("Rock.dat", entries(expected));
    expectFile("Rock.art", articles(art));
    EXPECT_EQ(platform.shown().size(), 1u);
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
        expectFile(list + ".dat", kSkeletonDat);
        expectFile(list + ".art", kSkeletonArt);
        expectFile(list + ".arn", "A#001\r\n");
        expectFile(list + ".inf", flag);
        expectReset();
        EXPECT_EQ(titles(), (Strings{"Add an item and delete me!"}));
        EXPECT_EQ(view.Label2.caption(), "... amount:  1 ...");
        select("Add an item and delete me!");
        EXPECT_EQ(fields(), kPlaceholderFields);
    }
}

TEST_F(Form1Test, DeleteListAnsweredNoOrWithNothingSelectedChangesNothing) {
    putRock({"Jazz"});
    start();
    const Files before = snapshot();
    view.Command_delete.click();
    EXPECT_TRUE(platform.shown().empty());

    open("Rock");
    platform.answer(Answer::No);
    view.Command_delete.click();
    expectBox(0, 260, "DELETE?", kDeleteList);
    platform.answer(Answer::Yes);
    platform.answer(Answer::No);
    view.Command_delete.click();
    ASSERT_EQ(platform.shown().size(), 3u);
    EXPECT_EQ(platform.shown()[1].prompt, kDeleteList);
    expectBox(2, 308, "DELETE?", kReallySure);

    EXPECT_EQ(snapshot(), before);
    EXPECT_EQ(view.List_list.count(), 2);
    EXPECT_EQ(titles().size(), 5u);
}

TEST_F(Form1Test, DeleteListRemovesItsFilesAndOnlyItsOwnIndexLine) {
    const Strings lists = {"xabc", "abcd", "abc", "Jazz"};
    for (const std::string& list : lists) putList(list, kSkeletonDat, kSkeletonArt);
    folder.put("pemla.dat", crlf(lists));
    start();
    open("abc");
    // The index is read again when the list is deleted; its line is found ignoring case.
    folder.put("pemla.dat", crlf({"xabc", "abcd", "ABC", "Jazz"}));
    platform.answer(Answer::Yes);
    platform.answer(Answer::Yes);
    view.Command_delete.click();
    expectFile("pemla.dat", crlf({"xabc", "abcd", "Jazz"}));
    for (const char* ext : {".dat", ".art", ".arn", ".inf"}) {
        EXPECT_FALSE(folder.has(std::string("abc") + ext)) << ext;
        EXPECT_TRUE(folder.has(std::string("abcd") + ext)) << ext;
        EXPECT_TRUE(folder.has(std::string("xabc") + ext)) << ext;
    }
    EXPECT_EQ(view.List_list.items(), (Strings{"abcd", "Jazz", "xabc"}));
    EXPECT_EQ(view.List_list.selectedIndex(), -1);
    EXPECT_TRUE(titles().empty());

    // With no list open, "Add" only clears the fields.
    const Files before = snapshot();
    fill({"Orphan", "CD", "1", ""});
    view.Command_add.click();
    EXPECT_EQ(snapshot(), before);
    expectReset();
    EXPECT_EQ(platform.shown().size(), 2u);
}

TEST_F(Form1Test, DeleteListWithMissingFilesDeletesTheRestAndItsLine) {
    putRock();
    folder.put("abc.dat", kSkeletonDat);
    folder.put("abc.art", kSkeletonArt);
    folder.put("pemla.dat", crlf({"Rock", "abc"}));
    start();
    open("abc");  // no flag file: opens as a list with the information column
    platform.answer(Answer::Yes);
    platform.answer(Answer::Yes);
    view.Command_delete.click();
    EXPECT_EQ(platform.shown().size(), 2u);
    expectFile("pemla.dat", crlf({"Rock"}));
    EXPECT_FALSE(folder.has("abc.dat"));
    EXPECT_FALSE(folder.has("abc.art"));
    EXPECT_EQ(view.List_list.items(), (Strings{"Rock"}));
}

TEST_F(Form1Test, DeletingTheOnlyListLeavesThePlaceholderList) {
    // The placeholder list itself, being the only list, is renewed rather than lost.
    for (const std::string& list : {std::string("Rock"), kPlaceholderList}) {
        SCOPED_TRACE(list);
        test_support::MainWindowFixture fresh;
        if (list == "Rock") {
            fresh.putList("Rock", entries(rock), articles(rockArt), rockArn);
        } else {
            // Made by an older copy: a real entry added, and no flag file.
            fresh.putList(list, kSkeletonDat + entries({{"Mine", "CD", "1", ""}}),
                          kSkeletonArt + articles({{"Mine", "M001"}}), "A#001\r\nM#002\r\n", "");
        }
        fresh.folder.put("pemla.dat", crlf({list}));
        fresh.start();
        fresh.open(list);
        fresh.platform.answer(Answer::Yes);
        fresh.platform.answer(Answer::Yes);
        fresh.view.Command_delete.click();

        EXPECT_EQ(fresh.folder.get("pemla.dat"), crlf({kPlaceholderList}));
        EXPECT_EQ(fresh.folder.get(kPlaceholderList + ".dat"), kSkeletonDat);
        EXPECT_EQ(fresh.folder.get(kPlaceholderList + ".art"), kSkeletonArt);
        EXPECT_EQ(fresh.folder.get(kPlaceholderList + ".arn"), "A#001\r\n");
        EXPECT_EQ(fresh.folder.get(kPlaceholderList + ".inf"), " 1 \r\n");
        EXPECT_EQ(fresh.folder.listing(),
                  "Add one & delete me!.arn\nAdd one & delete me!.art\nAdd one & delete me!.dat\n"
                  "Add one & delete me!.inf\ninformation.dat\npemla.dat\ntype.dat\n");
        EXPECT_EQ(fresh.view.List_list.items(), (Strings{kPlaceholderList}));
        EXPECT_TRUE(fresh.view.List1.items().empty());

        fresh.open(kPlaceholderList);
        EXPECT_EQ(fresh.view.List1.items(), (Strings{"Add an item and delete me!"}));
        EXPECT_EQ(fresh.view.Label2.caption(), "... amount:  1 ...");
        EXPECT_TRUE(fresh.view.Combo3.isEnabled());
        EXPECT_EQ(fresh.platform.shown().size(), 2u);
    }
}

}  // namespace
}  // namespace main_window_test
