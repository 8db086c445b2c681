// The new-list dialog on the memory controls, over a real catalogue folder: what it writes byte
// for byte, what it refuses without touching a file, and how it leaves the main window.
#include "new_list/form_new_list.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <filesystem>
#include <iostream>
#include <map>
#include <memory>

#include "catalogue/folder_lock.h"
#include "tests/support/faulty_sys.h"
#include "tests/support/memory/memory_controls.h"
#include "tests/support/memory_form1.h"

namespace {

using test_support::SysCall;
using Files = std::map<std::string, std::string>;
using namespace ui::memory;

const std::string kRefused = "A list with that name already exist!";
const std::string kProbeFailed = "Ya can't use /\\:?*<>\" in the name!";

// The five files "Create" writes for `name` with the information column on, over `before`.
Files created(Files files, const std::string& name, const std::string& index) {
    files["pemla.dat"] = index;
    files[name + ".dat"] =
        "<|?Add an item and delete me!\r\n<|'DELETE ME!\r\n<||DELETE ME!\r\n<|*DELETE ME!\r\n";
    files[name + ".art"] = "Add an item and delete me!#*\\A001\r\n";
    files[name + ".arn"] = "A#001\r\n";
    files[name + ".inf"] = " 1 \r\n";
    return files;
}

// The main window with the new-list dialog on memory controls; the dialog may work through a
// store of its own (one with a failing system call) on the same folder.
struct NewListDialog {
    explicit NewListDialog(const std::string& index = "", catalogue::Sys* sys = nullptr) {
        for (Owned* control :
             std::initializer_list<Owned*>{&Text1, &Check_info, &Command1, &Command2}) {
            control->setOwner(&window);
        }
        if (sys != nullptr) ownStore = std::make_unique<catalogue::Store>(f.folder.path(), *sys);
        dialog = std::make_unique<new_list::Form_new_list>(
            new_list::Form_new_listControls{window, Label1, Text1, Check_info, Command1, Command2},
            f.platform, ownStore ? *ownStore : f.store, *f.form);
        f.form->setDialogs({&window, nullptr, nullptr});
        f.folder.put("pemla.dat", index);
    }

    // Opens the dialog from the main window and creates `name` as a user would; afterwards the
    // dialog is gone and the main window usable again, whatever the outcome.
    void create(const std::string& name, bool information = true) {
        if (!f.view.window.isLoaded()) f.start();
        ASSERT_TRUE(f.view.Command_create.click());
        Text1.type(name);
        if (!information) Check_info.userToggle();
        ASSERT_TRUE(Command1.click());
        EXPECT_FALSE(window.isLoaded());
        EXPECT_TRUE(f.view.window.isEnabled());
    }

    // Creates `name` expecting one error box saying `prompt` and no file touched but `stray`.
    void refuse(const std::string& name, const std::string& prompt, const std::string& stray = "") {
        if (!f.view.window.isLoaded()) f.start();
        const Files before = files();
        f.platform.answer(ui::Answer::Ok);
        create(name);
        ASSERT_EQ(f.platform.shown().size(), 1u);
        EXPECT_EQ(f.platform.shown()[0].prompt, prompt);
        EXPECT_EQ(f.platform.shown()[0].title, "Error");
        EXPECT_EQ(f.platform.shown()[0].style, 16);
        Files after = files();
        after.erase(stray);
        after.erase(std::string(catalogue::kJournalName));
        EXPECT_EQ(after, before);
    }

    Files files() const {
        Files all;
        for (const auto& item : std::filesystem::directory_iterator(f.folder.path())) {
            const std::string name = item.path().filename();
            if (name != catalogue::kLockName) all[name] = f.folder.get(name);
        }
        return all;
    }

    test_support::MainWindowFixture f;
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
    EXPECT_EQ(d.window.caption() + "|" + d.Label1.caption() + "|" + d.Check_info.caption() + "|" +
                  d.Command1.caption() + "|" + d.Command2.caption(),
              "Create new list|Name of new list (only file allowed charters!)|"
              "Include information column|Create|Cancel");
    EXPECT_TRUE(d.Text1.hasFocus());
    EXPECT_FALSE(d.f.view.Command_create.click()) << "the main window takes no input";
    d.Text1.type(std::string(30, 'x'));
    EXPECT_EQ(d.Text1.text(), std::string(26, 'x'));
    d.Check_info.userToggle();

    const int fronted = d.f.view.window.frontCount();
    ASSERT_TRUE(d.Command2.click());
    EXPECT_TRUE(!d.window.isLoaded() && d.f.view.window.isEnabled());
    EXPECT_GT(d.f.view.window.frontCount(), fronted);

    // Each opening starts afresh; the close box also gives the main window back, and closing
    // the main window takes an open dialog with it.
    ASSERT_TRUE(d.f.view.Command_create.click());
    EXPECT_EQ(d.Text1.text(), "");
    EXPECT_EQ(d.Check_info.value(), 1);
    d.window.userClose();
    EXPECT_TRUE(!d.window.isLoaded() && d.f.view.window.isEnabled());
    ASSERT_TRUE(d.f.view.Command_create.click());
    d.f.view.window.userClose();
    EXPECT_FALSE(d.window.isLoaded());
    EXPECT_EQ(d.files().at("pemla.dat"), "");
}

TEST(NewListDialog, CreatesTheListWithTheSkeletonAndRefillsTheMainWindow) {
    NewListDialog d("Rock\r\nPop\r\n");
    d.f.putList("Pop", "<|?Abba Gold\r\n<|'CD\r\n<||1\r\n<|*Original\r\n", "Abba Gold#*\\A001\r\n");
    d.f.start();
    d.f.open("Pop");
    ASSERT_EQ(d.f.view.List1.count(), 1);
    const Files before = d.files();

    d.create("Jazz Caf\xE9");  // a Latin-1 name, as the controls hand it over
    // The index keeps the Latin-1 name and the files are named by its UTF-8 bytes. Nothing else
    // is left behind: no probe file, journal or staged file.
    EXPECT_EQ(d.files(), created(before, "Jazz Caf\xC3\xA9", "Rock\r\nPop\r\nJazz Caf\xE9\r\n"));
    EXPECT_EQ(d.f.view.List_list.items(),
              (std::vector<std::string>{"Jazz Caf\xE9", "Pop", "Rock"}));
    EXPECT_EQ(d.f.view.List_list.selectedIndex(), -1);
    EXPECT_EQ(d.f.view.List1.count(), 0);

    d.create("Blues", false);
    EXPECT_EQ(d.files().at("Blues.inf"), " 0 \r\n");
    EXPECT_EQ(d.files().at("pemla.dat"), "Rock\r\nPop\r\nJazz Caf\xE9\r\nBlues\r\n");
    EXPECT_TRUE(d.f.platform.shown().empty());
}

TEST(NewListDialog, RefusesNamesInUseOrReservedOrNoPortableFileNameWithoutTouchingAFile) {
    // In use ignoring case, a name a listed name ends with, every reserved word in any case and
    // every trailing part of one, and the empty name.
    for (const std::string name : {"", "hard ROCK", "Rock", "k", " Rock", "EXPORT", "Print",
                                   "pemla", "iNFORMATION", "type", "port", "ation", "e", "MLA"}) {
        SCOPED_TRACE("name \"" + name + "\"");
        NewListDialog("Hard Rock\r\nPop\r\n").refuse(name, kRefused);
    }
    for (const std::string& name : std::initializer_list<std::string>{
             "a/b", "a\\b", "C:", "why?", "*", "<x", "x>", "say \"hi\"", "a|b", "tab\there",
             std::string("nul\0x", 5), "del\x7f", "c1\x85", ".", ".."}) {
        SCOPED_TRACE("name \"" + name + "\"");
        NewListDialog("Pop\r\n").refuse(name, kProbeFailed);
    }
    // A file system that refuses the probe file (its open comes after the journal's), or will
    // not delete it even when asked twice: the probe and its record are left for the next start.
    for (const SysCall kind : {SysCall::Open, SysCall::Unlink}) {
        SCOPED_TRACE(test_support::sysCallName(kind));
        test_support::FaultySys sys;
        sys.failAt(kind, kind == SysCall::Open ? 2 : 1, kind == SysCall::Open ? EINVAL : EACCES, 2);
        NewListDialog d("", &sys);
        d.refuse("Jazz", kProbeFailed, "Jazz.del");
        EXPECT_TRUE(sys.fired());
        catalogue::Store(d.f.folder.path()).recover();
        EXPECT_FALSE(d.f.folder.has("Jazz.del") || d.f.folder.has(catalogue::kJournalName));
    }
    std::string full;
    for (int i = 0; i < 32767; ++i) full += "List " + std::to_string(i) + "\r\n";
    NewListDialog(full).refuse("One more", "The catalogue is full: it holds at most 32767 lists.");
}

TEST(NewListDialog, AcceptsNamesThatOnlyBeginLikeAListOrHoldAReservedWord) {
    NewListDialog d("Hard Rock\r\n\r\nOld");  // a blank line, and a last line without CR LF
    for (const std::string name : {"Hard", "exports", "myexport", "xpor", "Type A", "a.b", "..."}) {
        d.create(name);
        EXPECT_TRUE(d.f.folder.has(name + ".dat")) << name;
    }
    EXPECT_TRUE(d.f.platform.shown().empty());
    EXPECT_EQ(
        d.f.folder.get("pemla.dat"),
        "Hard Rock\r\n\r\nOld\r\nHard\r\nexports\r\nmyexport\r\nxpor\r\nType A\r\na.b\r\n...\r\n");
}

TEST(NewListDialog, ProbeLeavesAFileTheUserAlreadyHad) {
    NewListDialog d;
    d.f.folder.put("Jazz.del", "my notes");
    d.f.folder.put("type.del", "mine");
    d.refuse("type", kRefused);  // also when the name is then refused
    const Files before = d.files();
    d.create("Jazz");
    EXPECT_EQ(d.files(), created(before, "Jazz", "Jazz\r\n"));
}

// A failure at any system call of "Create" leaves the folder exactly as it was and says so, or
// completes the whole list: never an index line without its files, nor files without it.
TEST(NewListDialog, AFailedCreationLeavesNoHalfList) {
    int points = 0, kept = 0;
    for (const SysCall kind : {SysCall::Open, SysCall::Read, SysCall::Write, SysCall::Fsync,
                               SysCall::Close, SysCall::Rename}) {
        for (int n = 1;; ++n) {
            SCOPED_TRACE(std::string(test_support::sysCallName(kind)) + " #" + std::to_string(n));
            test_support::FaultySys sys;
            sys.failAt(kind, n, EIO);
            NewListDialog d("Pop\r\n", &sys);
            const Files before = d.files();
            d.f.platform.answer(ui::Answer::Ok);
            d.create("Jazz");
            if (d.files() == before) {
                ++kept;
                ASSERT_EQ(d.f.platform.shown().size(), 1u) << "a failure the user is not told of";
                EXPECT_EQ(d.f.platform.shown()[0].style, 16);
            } else {
                EXPECT_EQ(d.files(), created(before, "Jazz", "Pop\r\nJazz\r\n"));
            }
            if (!sys.fired()) break;
            ++points;
        }
    }
    std::cout << "Create: " << points << " fault points, " << kept << " kept the old files\n";
    EXPECT_GT(kept, 0);
}

}  // namespace
