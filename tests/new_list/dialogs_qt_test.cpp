// The new-list and search dialogs on Qt, opened from the real main window through its buttons:
// the main window is disabled while a dialog is open and usable again however it closes.
#include <gtest/gtest.h>

#include <QTest>
#include <QWindow>
#include <filesystem>

#include "app/program.h"
#include "tests/e2e/qt_user.h"
#include "tests/support/temp_folder.h"

namespace {

using qt_user::click;

// A dialog is a window of its own above the main window, not one of its children, so that
// disabling the main window leaves the dialog usable.
void expectOwnWindowAbove(QWidget* dialog, QWidget* main) {
    EXPECT_TRUE(dialog->isVisible() && dialog->isWindow() && dialog->isEnabled());
    EXPECT_EQ(dialog->parentWidget(), nullptr);
    ASSERT_NE(dialog->windowHandle(), nullptr);
    EXPECT_EQ(dialog->windowHandle()->transientParent(), main->windowHandle());
    EXPECT_FALSE(main->isEnabled());
}

// Creating a list and searching through these dialogs on Qt is the end-to-end test's part; here
// the opening, the keys they ignore and the closing by the close box.
TEST(DialogsOnQt, EachDialogDisablesTheMainWindowUntilItCloses) {
    test_support::TempFolder folder;
    test_support::putMusicCatalogue(folder);
    qt_user::Boxes boxes;
    ui::qt::QtPlatform platform;
    app::Program program(folder.path(), platform);
    program.start();
    app::MainWindowView& view = program.mainWindow();
    app::NewListView& newListView = program.newListDialog();
    app::SearchView& searchView = program.searchDialog();
    QWidget* newList = newListView.widget();
    QWidget* search = searchView.widget();

    click(view.Command_create);
    expectOwnWindowAbove(newList, view.widget());
    EXPECT_EQ(newList->windowTitle(), QStringLiteral("Create new list"));
    EXPECT_EQ(newList->focusWidget(), newListView.Text1);
    EXPECT_EQ(newListView.Text1->maxLength(), 26);
    // Enter and Escape do nothing, in the name box and on a focused button alike.
    QTest::keyClicks(newListView.Text1, QStringLiteral("Jazz"));
    QTest::keyClick(newListView.Text1, Qt::Key_Return);
    QTest::keyClick(newListView.Text1, Qt::Key_Escape);
    newListView.Command1->setFocus();
    QTest::keyClick(newListView.Command1, Qt::Key_Return);
    QTest::keyClick(newListView.Command1, Qt::Key_Enter);
    QTest::keyClick(newListView.Command2, Qt::Key_Escape);
    EXPECT_TRUE(newList->isVisible());
    newList->close();  // the close box
    EXPECT_TRUE(!newList->isVisible() && view.widget()->isEnabled());
    EXPECT_EQ(folder.get("pemla.dat"), "Music\r\n");

    qt_user::pick(view.List_list, QStringLiteral("Music"));
    click(view.Command_search);
    expectOwnWindowAbove(search, view.widget());
    EXPECT_EQ(search->windowTitle(), QStringLiteral("Search article number"));
    EXPECT_EQ(search->focusWidget(), searchView.Text1);
    QTest::keyClicks(searchView.Text1, QStringLiteral("a0011"));
    EXPECT_EQ(searchView.Text1->text(), QStringLiteral("a001"));
    QTest::keyClick(searchView.Text1, Qt::Key_Return);
    QTest::keyClick(searchView.Text1, Qt::Key_Escape);
    EXPECT_TRUE(search->isVisible());
    EXPECT_EQ(searchView.Text2->text(), QString()) << "Enter does not search";
    search->close();  // the close box
    EXPECT_TRUE(!search->isVisible() && view.widget()->isEnabled());

    // Without its article file the list cannot be searched: the box names the file, and the
    // dialog never stays open over a disabled main window.
    std::filesystem::remove(folder.file("Music.art"));
    click(view.Command_search);
    ASSERT_EQ(boxes.shown.size(), 1u);
    EXPECT_NE(boxes.shown[0].find("\"Music.art\""), std::string::npos) << boxes.shown[0];
    EXPECT_TRUE(!search->isVisible() && view.widget()->isEnabled());
}

}  // namespace
