// The new-list dialog on the memory controls, over a real catalogue folder: what it writes byte
// for byte, what it refuses without touching a file, and how it leaves the main window.
#include "new_list/form_new_list.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <filesystem>
#include <map>
#include <memory>

#include "tests/support/faulty_sys.h"
#include "tests/support/memory_form1.h"
#include "ui/memory/memory_controls.h"

namespace {

using test_support::MainWindowFixture;
using ui::Answer;
using namespace ui::memory;

const std::string kEntries =
    "<|?Add an item and delete me!\r\n<|'DELETE ME!\r\n<||DELETE ME!\r\n<|*DELETE ME!\r\n";
const std::string kArticles = "Add an item and delete me!#*\\A001\r\n";
const std::string kCounter = "A#001\r\n";
const std::string kRefused = "A list with that name already exist!";
const std::string kProbeFailed = "Ya can't use /\\:?*<>\" in the name!";

// The main window with the new-list dialog on memory controls; the dialog may work through a
// store of its own (one with a failing system call) on the same folder.
struct NewListDialog {
    explicit NewListDialog(catalogue::Sys* sys = nullptr) {
        for (Owned* control :
             std::initializer_list<Owned*>{&Text1, &Check_info, &Command1, &Command2}) {
            control->setOwner(&window);
        }
        if (sys != nullptr) ownStore = std::make_unique<catalogue::Store>(f.folder.path(), *sys);
        dialog = std::make_unique<new_list::Form_new_list>(
            new_list::Form_new_listControls{window, Label1, Text1, Check_info, Command1, Command2},
            f.platform, ownStore ? *ownStore : f.store, *f.form);
        f.form->setDialogs({&window, nullptr, nullptr});
    }

    // Opens the dialog from the main window and creates `name` as a user would.
    void create(const std::string& name, bool information = true) {
        if (!f.view.window.isLoaded()) f.start();
        ASSERT_TRUE(f.view.Command_create.click());
        Text1.type(name);
        if (!information) Check_info.userToggle();
        ASSERT_TRUE(Command1.click());
    }

    std::map<std::string, std::string> files() const {
        std::map<std::string, std::string> all;
        for (const auto& item : std::filesystem::directory_iterator(f.folder.path())) {
            const std::string name = item.path().filename().string();
            all[name] = f.folder.get(name);
        }
        return all;
    }

    // After any outcome of "Create": the dialog is gone and the main window usable again.
    void expectClosed() const {
        EXPECT_FALSE(window.isLoaded());
        EXPECT_TRUE(f.view.window.isEnabled());
    }

    MainWindowFixture f;
    std::unique_ptr<catalogue::Store> ownStore;
    MemoryWindow window;
    MemoryLabel Label1;
    MemoryTextBox Text1;
    MemoryCheckBox Check_info;
    MemoryButton Command1;
    MemoryButton Command2;
    std::unique_ptr<new_list::Form_new_list> dialog;
};

TEST(NewListDialog, OpensOverADisabledMainWindowAndClosesEveryWay) {
    NewListDialog d;
    d.f.start();
    ASSERT_TRUE(d.f.view.Command_create.click());
    EXPECT_TRUE(d.window.isLoaded());
    EXPECT_EQ(d.window.caption(), "Create new list");
    EXPECT_EQ(d.Label1.caption(), "Name of new list (only file allowed charters!)");
    EXPECT_EQ(d.Check_info.caption(), "Include information column");
    EXPECT_EQ(d.Command1.caption(), "Create");
    EXPECT_EQ(d.Command2.caption(), "Cancel");
    EXPECT_TRUE(d.Text1.hasFocus());
    EXPECT_EQ(d.Check_info.value(), 1);
    EXPECT_FALSE(d.f.view.window.isEnabled());
    EXPECT_FALSE(d.f.view.Command_create.click()) << "the main window takes no input";

    // At most 26 characters can be typed.
    d.Text1.type(std::string(30, 'x'));
    EXPECT_EQ(d.Text1.text(), std::string(26, 'x'));
    d.Check_info.userToggle();

    const int fronted = d.f.view.window.frontCount();
    ASSERT_TRUE(d.Command2.click());
    d.expectClosed();
    EXPECT_GT(d.f.view.window.frontCount(), fronted);

    // Each opening starts afresh; the close box also gives the main window back.
    ASSERT_TRUE(d.f.view.Command_create.click());
    EXPECT_EQ(d.Text1.text(), "");
    EXPECT_EQ(d.Check_info.value(), 1);
    d.window.userClose();
    d.expectClosed();

    // Closing the main window takes an open dialog with it.
    ASSERT_TRUE(d.f.view.Command_create.click());
    d.f.view.window.userClose();
    EXPECT_FALSE(d.window.isLoaded());
    EXPECT_EQ(d.f.folder.get("pemla.dat"), "");
    EXPECT_TRUE(d.f.platform.shown().empty());
}

TEST(NewListDialog, CreatesTheListWithTheSkeletonAndRefillsTheMainWindow) {
    NewListDialog d;
    d.f.folder.put("pemla.dat", "Rock\r\n");
    d.f.putList("Rock", "<|?Abba Gold\r\n<|'CD\r\n<||1\r\n<|*Original\r\n",
                "Abba Gold#*\\A001\r\n");
    d.f.start();
    d.f.open("Rock");
    ASSERT_EQ(d.f.view.List1.count(), 1);

    d.create("Jazz Caf\xE9");  // a Latin-1 name, as the controls hand it over
    d.expectClosed();
    EXPECT_TRUE(d.f.platform.shown().empty());
    EXPECT_EQ(d.f.folder.get("pemla.dat"), "Rock\r\nJazz Caf\xE9\r\n");
    EXPECT_EQ(d.f.folder.get("Jazz Caf\xE9.dat"), kEntries);
    EXPECT_EQ(d.f.folder.get("Jazz Caf\xE9.art"), kArticles);
    EXPECT_EQ(d.f.folder.get("Jazz Caf\xE9.arn"), kCounter);
    EXPECT_EQ(d.f.folder.get("Jazz Caf\xE9.inf"), " 1 \r\n");
    // Nothing else is left behind: no probe file, journal or staged file.
    EXPECT_EQ(d.f.folder.listing(),
              "Jazz Caf\xE9.arn\nJazz Caf\xE9.art\nJazz Caf\xE9.dat\nJazz Caf\xE9.inf\n"
              "Rock.arn\nRock.art\nRock.dat\nRock.inf\ninformation.dat\npemla.dat\ntype.dat\n");

    EXPECT_EQ(d.f.view.List_list.items(), (std::vector<std::string>{"Jazz Caf\xE9", "Rock"}));
    EXPECT_EQ(d.f.view.List_list.selectedIndex(), -1);
    EXPECT_EQ(d.f.view.List1.count(), 0);

    d.create("Blues", false);
    EXPECT_EQ(d.f.folder.get("Blues.inf"), " 0 \r\n");
    EXPECT_EQ(d.f.folder.get("pemla.dat"), "Rock\r\nJazz Caf\xE9\r\nBlues\r\n");
    EXPECT_EQ(d.f.view.List_list.count(), 3);
}

TEST(NewListDialog, RewritesTheIndexWithEveryLineEndedAndBlankLinesKept) {
    NewListDialog d;
    d.f.folder.put("pemla.dat", "Rock\r\n\r\nPop");
    d.create("Jazz");
    EXPECT_EQ(d.f.folder.get("pemla.dat"), "Rock\r\n\r\nPop\r\nJazz\r\n");

    NewListDialog empty;
    empty.create("Jazz");
    EXPECT_EQ(empty.f.folder.get("pemla.dat"), "Jazz\r\n");
}

TEST(NewListDialog, RefusesNamesInUseOrReservedWithoutTouchingAFile) {
    // In use ignoring case, a name a listed name ends with, every reserved word in any case and
    // every trailing part of one, and the empty name.
    for (const std::string name : {"", "hard ROCK", "Rock", "k", " Rock", "EXPORT", "Print",
                                   "pemla", "iNFORMATION", "type", "port", "ation", "e", "MLA"}) {
        SCOPED_TRACE("name \"" + name + "\"");
        NewListDialog d;
        d.f.folder.put("pemla.dat", "Hard Rock\r\nPop\r\n");
        const auto before = d.files();
        d.f.platform.answer(Answer::Ok);
        d.create(name);
        ASSERT_EQ(d.f.platform.shown().size(), 1u);
        EXPECT_EQ(d.f.platform.shown()[0].prompt, kRefused);
        EXPECT_EQ(d.f.platform.shown()[0].title, "Error");
        EXPECT_EQ(d.f.platform.shown()[0].style, 16);
        EXPECT_EQ(d.files(), before);
        d.expectClosed();
    }
}

TEST(NewListDialog, AFullCatalogueTakesNoFurtherList) {
    NewListDialog d;
    std::string index;
    for (int i = 0; i < 32767; ++i) index += "List " + std::to_string(i) + "\r\n";
    d.f.folder.put("pemla.dat", index);
    d.f.start();
    const auto before = d.files();
    d.f.platform.answer(Answer::Ok);
    d.create("One more");
    ASSERT_EQ(d.f.platform.shown().size(), 1u);
    EXPECT_NE(d.f.platform.shown()[0].prompt.find("32767 lists"), std::string::npos);
    EXPECT_EQ(d.files(), before);
    d.expectClosed();
}

TEST(NewListDialog, AcceptsNamesThatOnlyBeginLikeAListOrHoldAReservedWord) {
    NewListDialog d;
    d.f.folder.put("pemla.dat", "Hard Rock\r\n");
    for (const std::string name : {"Hard", "exports", "myexport", "Type A", "a.b", "..."}) {
        d.create(name);
        EXPECT_TRUE(d.f.folder.has(name + ".dat")) << name;
    }
    EXPECT_TRUE(d.f.platform.shown().empty());
    EXPECT_EQ(d.f.folder.get("pemla.dat"),
              "Hard Rock\r\nHard\r\nexports\r\nmyexport\r\nType A\r\na.b\r\n...\r\n");
}

TEST(NewListDialog, RefusesNamesThatAreNoPortableFileName) {
    for (const std::string& name : std::initializer_list<std::string>{
             "a/b", "a\\b", "C:", "why?", "*", "<x", "x>", "say \"hi\"", "a|b", "tab\there",
             std::string("nul\0x", 5), "del\x7f", "c1\x85", ".", ".."}) {
        SCOPED_TRACE("name \"" + name + "\"");
        NewListDialog d;
        d.f.folder.put("pemla.dat", "Pop\r\n");
        const auto before = d.files();
        d.f.platform.answer(Answer::Ok);
        d.create(name);
        ASSERT_EQ(d.f.platform.shown().size(), 1u);
        EXPECT_EQ(d.f.platform.shown()[0].prompt, kProbeFailed);
        EXPECT_EQ(d.f.platform.shown()[0].title, "Error");
        EXPECT_EQ(d.f.platform.shown()[0].style, 16);
        EXPECT_EQ(d.files(), before);
        d.expectClosed();
    }
}

TEST(NewListDialog, ProbeLeavesAFileTheUserAlreadyHad) {
    NewListDialog d;
    d.f.folder.put("Jazz.del", "my notes");
    d.create("Jazz");
    EXPECT_TRUE(d.f.platform.shown().empty());
    EXPECT_EQ(d.f.folder.get("Jazz.del"), "my notes");
    EXPECT_EQ(d.f.folder.get("pemla.dat"), "Jazz\r\n");

    // Also when the name is then refused.
    NewListDialog refused;
    refused.f.folder.put("type.del", "mine");
    refused.f.platform.answer(Answer::Ok);
    refused.create("type");
    EXPECT_EQ(refused.f.platform.shown().at(0).prompt, kRefused);
    EXPECT_EQ(refused.f.folder.get("type.del"), "mine");
}

TEST(NewListDialog, ReportsAFileSystemThatRefusesTheProbe) {
    using test_support::SysCall;
    for (const SysCall kind : {SysCall::Open, SysCall::Unlink}) {
        SCOPED_TRACE(test_support::sysCallName(kind));
        test_support::FaultySys sys;
        sys.failAt(kind, 1, kind == SysCall::Open ? EINVAL : EACCES);
        NewListDialog d(&sys);
        d.f.platform.answer(Answer::Ok);
        d.create("Jazz");
        ASSERT_TRUE(sys.fired());
        ASSERT_EQ(d.f.platform.shown().size(), 1u);
        EXPECT_EQ(d.f.platform.shown()[0].prompt, kProbeFailed);
        EXPECT_EQ(d.f.folder.get("pemla.dat"), "");
        EXPECT_FALSE(d.f.folder.has("Jazz.dat"));
        d.expectClosed();
    }
}

// A failure at any system call of "Create" leaves the folder exactly as it was and says so, or
// completes the whole list: never an index line without its files, nor files without it.
TEST(NewListDialog, AFailedCreationLeavesNoHalfList) {
    using test_support::SysCall;
    for (const SysCall kind : {SysCall::Open, SysCall::Read, SysCall::Write, SysCall::Fsync,
                               SysCall::Close, SysCall::Rename}) {
        for (int n = 1;; ++n) {
            SCOPED_TRACE(std::string(test_support::sysCallName(kind)) + " #" + std::to_string(n));
            test_support::FaultySys sys;
            sys.failAt(kind, n, EIO);
            NewListDialog d(&sys);
            d.f.folder.put("pemla.dat", "Pop\r\n");
            const auto before = d.files();
            d.f.platform.answer(Answer::Ok);
            d.create("Jazz");
            d.expectClosed();
            const auto after = d.files();
            if (after == before) {
                ASSERT_EQ(d.f.platform.shown().size(), 1u) << "a failure the user is not told of";
                EXPECT_EQ(d.f.platform.shown()[0].title, "Error");
                EXPECT_EQ(d.f.platform.shown()[0].style, 16);
            } else {
                auto expected = before;
                expected["pemla.dat"] = "Pop\r\nJazz\r\n";
                expected["Jazz.dat"] = kEntries;
                expected["Jazz.art"] = kArticles;
                expected["Jazz.arn"] = kCounter;
                expected["Jazz.inf"] = " 1 \r\n";
                EXPECT_EQ(after, expected);
            }
            if (!sys.fired()) break;
        }
    }
}

}  // namespace
