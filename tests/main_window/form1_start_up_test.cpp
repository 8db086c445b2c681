// Start-up, the buttons that open dialogs or end the program, and closing the window.
#include "tests/main_window/form1_test_fixture.h"

namespace main_window_test {
namespace {

using ui::memory::MemoryWindow;

Strings itemsOf(const ui::ComboBox& box) {
    Strings items;
    for (int i = 0; i < box.itemCount(); ++i) items.push_back(box.itemText(i));
    return items;
}

TEST_F(Form1Test, StartUpFillsTheBoxesButNeverOffersASuggestionFilesFirstLine) {
    folder.put("pemla.dat", crlf({"Rock", "Jazz", "ambient"}));
    start();
    EXPECT_EQ(itemsOf(view.Combo1), (Strings{"Music CD", "DVD video", "Game"}));
    EXPECT_EQ(itemsOf(view.Combo3), (Strings{"Original", "Copy"}));
    EXPECT_EQ(itemsOf(view.Combo2), (Strings{"1", "2", "3", "4", "5", "6", "7", "8", "9", "10"}));
    EXPECT_EQ(view.List_list.items(), (Strings{"ambient", "Jazz", "Rock"}));
    expectReset();
    EXPECT_EQ(view.Label2.caption(), "... amount ...");
    EXPECT_EQ(view.Text1.maxLength(), 26);
    EXPECT_EQ(view.Label4.caption(), " Title" + std::string(62, ' ') + "Type" +
                                         std::string(41, ' ') + "CD's" + std::string(13, ' ') +
                                         "Information");
}

// An earlier build named a list's files with the Latin-1 bytes of its name. At the start they
// take their UTF-8 names, bytes untouched, and the list opens as before.
TEST_F(Form1Test, FilesNamedByAnEarlierBuildAreRenamedAndKeptWhole) {
    putRock(folder);
    const std::string latin1 = "B\xFChne", utf8 = "B\xC3\xBChne";
    folder.put("pemla.dat", crlf({"Rock", latin1}));
    for (const std::string ending : {".dat", ".art", ".arn", ".inf", ".top"})
        folder.put(latin1 + ending, ending == ".dat"   ? entryText(kRock)
                                    : ending == ".inf" ? " 1 "
                                                       : ending);
    folder.put(utf8 + ".top", "newer");  // a file of the new name is never replaced
    Files old = files();
    for (const std::string ending : {".dat", ".art", ".arn", ".inf"})
        old[utf8 + ending] = old.extract(latin1 + ending).mapped();
    start();
    EXPECT_EQ(files(), old);
    open(latin1);
    EXPECT_EQ(titles().size(), kRock.size());
}

// "Search" needs a selected list, "Export" one with entries shown; otherwise they beep.
TEST_F(Form1Test, DialogsOpenOnlyOnceAListIsSelectedAndOpen) {
    MemoryWindow newList, search, exporter;
    form->setDialogs({&newList, &exporter, &search});
    putRock(folder, {"Empty"});
    folder.put("Empty.dat", "");
    start();
    view.Command_search.click();
    view.Command_export.click();
    open("Empty");
    EXPECT_EQ(view.Label2.caption(), "... amount:  0 ...");
    view.Command_export.click();
    EXPECT_EQ(platform.beeps, 3);
    EXPECT_FALSE(search.isLoaded() || exporter.isLoaded());
    open("Rock");
    view.Command_search.click();
    view.Command_export.click();
    view.Command_create.click();
    EXPECT_EQ(platform.beeps, 3);
    EXPECT_TRUE(search.isLoaded() && exporter.isLoaded() && newList.isLoaded());
}

TEST(Form1StartUp, AMissingOrEmptyFileIsNamedWithItsFolderAndEndsWithStatusOne) {
    // A missing file of either kind fails the same read; an empty suggestion file has no
    // heading to skip.
    const std::pair<const char*, bool> cases[] = {
        {"pemla.dat", true}, {"type.dat", false}, {"information.dat", false}};
    for (const auto& [name, missing] : cases) {
        SCOPED_TRACE(std::string(name) + (missing ? " missing" : " empty"));
        test_support::MainWindowFixture fresh;
        missing ? fresh.folder.remove(name) : fresh.folder.put(name, "");
        fresh.platform.answer(Answer::Ok);
        fresh.start();
        ASSERT_EQ(fresh.platform.shown().size(), 1u);
        const auto& box = fresh.platform.shown().front();
        EXPECT_EQ(box.style, 16);
        EXPECT_NE(box.prompt.find("\"" + std::string(name) + "\""), std::string::npos)
            << box.prompt;
        EXPECT_NE(box.prompt.find(fresh.folder.path()), std::string::npos) << box.prompt;
        EXPECT_EQ(fresh.platform.ended, 1);
    }
}

// A second copy on a held folder reads and finishes nothing, not even the first copy's journal.
TEST_F(Form1Test, ASecondCopyNamesTheFolderAndEndsWithStatusThreeTouchingNothing) {
    putRock(folder);
    start();
    folder.put("pemla.journal", "the first copy's commit, under way");
    const Files before = files();
    ui::memory::MemoryPlatform other;
    MemoryForm1 otherView;
    main_window::Form1 second(otherView.controls(), other, store);
    other.answer(Answer::Ok);
    otherView.window.show();
    ASSERT_EQ(other.shown().size(), 1u);
    EXPECT_NE(other.shown()[0].prompt.find("\"" + folder.path() + "\""), std::string::npos);
    EXPECT_EQ(other.ended, 3);
    EXPECT_EQ(otherView.List_list.count(), 0);
    EXPECT_EQ(files(), before);
}

// "Exit" ends at once, unloading nothing; closing unloads the loaded dialogs, export first.
TEST_F(Form1Test, ExitEndsAtOnceAndClosingUnloadsTheLoadedDialogs) {
    MemoryWindow newList, exporter, search;
    Strings unloaded;
    form->setDialogs({&newList, &exporter, &search});
    exporter.onUnload = [&] { unloaded.push_back("export"); };
    newList.onUnload = [&] { unloaded.push_back("new list"); };
    search.onUnload = [&] { unloaded.push_back("search"); };
    start();
    newList.show();
    exporter.show();
    view.Command_print.click();
    EXPECT_EQ(platform.ended, 0);
    EXPECT_TRUE(unloaded.empty());
    view.window.userClose();
    EXPECT_EQ(unloaded, (Strings{"export", "new list"}));
}

}  // namespace
}  // namespace main_window_test
