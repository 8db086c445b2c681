// The new-list dialog on the memory controls beside the main window: the opening and closing that
// every dialog of the main window shares, and what "Create" shows. Which names are taken and the
// files a new list gets are the catalogue's tests.
#include "new_list/form_new_list.h"

#include <gtest/gtest.h>

#include "tests/support/memory_form1.h"

namespace {

// The main window with its new-list dialog on memory controls, and the list index `index`.
struct NewListDialog {
    explicit NewListDialog(const std::string& index = "") { f.folder.put("pemla.dat", index); }

    // Opens the dialog from the main window and creates `name` as a user would; afterwards the
    // dialog is gone and the main window usable again, whatever the outcome.
    void create(const std::string& name, bool information = true) {
        if (!f.view.window.isLoaded()) f.start();
        ASSERT_TRUE(f.view.Command_create.click());
        dialog.Text1.type(name);
        if (!information) dialog.Check_info.userToggle();
        ASSERT_TRUE(dialog.Command1.click());
        EXPECT_FALSE(dialog.window.isLoaded());
        EXPECT_TRUE(f.view.window.isEnabled());
    }

    test_support::MainWindowFixture f;
    test_support::MemoryNewList& dialog = f.newListView;
};

TEST(NewListDialog, OpensOverADisabledMainWindowAndClosesEveryWay) {
    NewListDialog d;
    d.f.start();
    ASSERT_TRUE(d.f.view.Command_create.click());
    EXPECT_EQ(d.dialog.window.caption() + "|" + d.dialog.Label1.caption() + "|" +
                  d.dialog.Check_info.caption() + "|" + d.dialog.Command1.caption() + "|" +
                  d.dialog.Command2.caption(),
              "Create new list|Name of new list (only file allowed charters!)|"
              "Include information column|Create|Cancel");
    EXPECT_TRUE(d.dialog.Text1.hasFocus());
    EXPECT_FALSE(d.f.view.Command_create.click()) << "the main window takes no input";
    d.dialog.Text1.type("Jazz");
    d.dialog.Check_info.userToggle();

    const int fronted = d.f.view.window.frontCount;
    ASSERT_TRUE(d.dialog.Command2.click());
    EXPECT_TRUE(!d.dialog.window.isLoaded() && d.f.view.window.isEnabled());
    EXPECT_GT(d.f.view.window.frontCount, fronted);

    // Each opening starts afresh; the close box also gives the main window back.
    ASSERT_TRUE(d.f.view.Command_create.click());
    EXPECT_EQ(d.dialog.Text1.text(), "");
    EXPECT_EQ(d.dialog.Check_info.value(), 1);
    d.dialog.window.userClose();
    EXPECT_TRUE(!d.dialog.window.isLoaded() && d.f.view.window.isEnabled());
    EXPECT_EQ(d.f.folder.get("pemla.dat"), "");
}

TEST(NewListDialog, CreatesTheListAndRefillsTheMainWindowOrShowsTheRefusal) {
    NewListDialog d("Rock\r\nPop\r\n");
    // A Latin-1 name, as the controls hand it over: the index keeps it, the files are named by
    // its UTF-8 bytes, and nothing else is left behind.
    d.create("Jazz Caf\xE9");
    d.create("Blues", false);
    EXPECT_EQ(d.f.folder.get("pemla.dat"), "Rock\r\nPop\r\nJazz Caf\xE9\r\nBlues\r\n");
    EXPECT_EQ(d.f.folder.get("Jazz Caf\xC3\xA9.inf") + d.f.folder.get("Blues.inf"),
              " 1 \r\n 0 \r\n");
    EXPECT_EQ(d.f.view.List_list.items(),
              (std::vector<std::string>{"Blues", "Jazz Caf\xE9", "Pop", "Rock"}));

    // A refused name: one error box, and nothing written.
    const std::string before = d.f.folder.listing() + d.f.folder.get("pemla.dat");
    d.f.platform.answer(ui::Answer::Ok);
    d.create("jazz caf\xC9");
    d.f.expectBox(0, 16, "Error", new_list::kNameInUse);
    EXPECT_EQ(d.f.folder.listing() + d.f.folder.get("pemla.dat"), before);
}

}  // namespace
