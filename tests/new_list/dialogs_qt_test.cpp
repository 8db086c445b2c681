// The new-list and search dialogs on Qt, opened from the real main window through its buttons:
// the main window is disabled while a dialog is open and usable again however it closes.
#include <gtest/gtest.h>

#include <QCheckBox>
#include <QLineEdit>
#include <QListWidget>
#include <QMessageBox>
#include <QPushButton>
#include <QTest>
#include <QWindow>
#include <filesystem>

#include "app/main_window_view.h"
#include "app/new_list_view.h"
#include "app/search_view.h"
#include "catalogue/store.h"
#include "main_window/form1.h"
#include "new_list/form_new_list.h"
#include "search/form_searchart.h"
#include "tests/support/temp_folder.h"
#include "ui/qt/qt_platform.h"

namespace {

// The four windows as the program builds them, on one catalogue folder.
struct QtWindows {
    explicit QtWindows(const test_support::TempFolder& folder)
        : store(folder.path()),
          form(view.controls(), platform, store),
          newListView(view.widget()),
          newList(newListView.controls(), platform, store, form),
          searchView(view.widget()),
          search(searchView.controls(), platform, store, form) {
        form.setDialogs({&newListView.controls().window, nullptr, &searchView.controls().window});
        view.controls().window.show();
    }

    void click(QPushButton* button) { QTest::mouseClick(button, Qt::LeftButton); }
    void select(QListWidget* list, const QString& text) {
        const auto found = list->findItems(text, Qt::MatchExactly);
        ASSERT_EQ(found.size(), 1) << text.toStdString();
        QTest::mouseClick(list->viewport(), Qt::LeftButton, {},
                          list->visualItemRect(found.front()).center());
    }

    catalogue::Store store;
    ui::qt::QtPlatform platform;
    app::MainWindowView view;
    main_window::Form1 form;
    app::NewListView newListView;
    new_list::Form_new_list newList;
    app::SearchView searchView;
    search::Form_searchart search;
};

// Records every message box and answers OK; cleared when the test ends.
struct BoxRecorder {
    BoxRecorder() {
        ui::qt::QtPlatform::setAnswerHook([this](QMessageBox& box) {
            texts.push_back(box.text());
            titles.push_back(box.windowTitle());
            return ui::Answer::Ok;
        });
    }
    ~BoxRecorder() { ui::qt::QtPlatform::setAnswerHook(nullptr); }
    QStringList texts;
    QStringList titles;
};

void putCatalogue(const test_support::TempFolder& folder) {
    folder.put("type.dat", "Types\r\nMusic CD\r\n");
    folder.put("information.dat", "Information\r\nOriginal\r\n");
    folder.put("pemla.dat", "Pop\r\n");
    folder.put("Pop.dat", "<|?Abba Gold\r\n<|'Music CD\r\n<||1\r\n<|*Original\r\n");
    folder.put("Pop.art", "Abba Gold#*\\A001\r\n");
    folder.put("Pop.arn", "A#002\r\n");
    folder.put("Pop.inf", " 1 \r\n");
}

// A dialog is a window of its own above the main window, not one of its children, so that
// disabling the main window leaves the dialog usable.
void expectOwnWindowAbove(QWidget* dialog, QWidget* main) {
    EXPECT_TRUE(dialog->isVisible());
    EXPECT_TRUE(dialog->isWindow());
    EXPECT_EQ(dialog->parentWidget(), nullptr);
    ASSERT_NE(dialog->windowHandle(), nullptr);
    EXPECT_EQ(dialog->windowHandle()->transientParent(), main->windowHandle());
    EXPECT_FALSE(main->isEnabled());
    EXPECT_TRUE(dialog->isEnabled());
}

TEST(DialogsOnQt, NewListDialogDisablesTheMainWindowUntilItCloses) {
    test_support::TempFolder folder;
    putCatalogue(folder);
    BoxRecorder boxes;
    QtWindows w(folder);
    QWidget* dialog = w.newListView.widget();

    w.click(w.view.Command_create);
    expectOwnWindowAbove(dialog, w.view.widget());
    EXPECT_EQ(dialog->windowTitle(), QStringLiteral("Create new list"));
    EXPECT_EQ(dialog->focusWidget(), w.newListView.Text1);
    EXPECT_TRUE(w.newListView.Check_info->isChecked());
    EXPECT_EQ(w.newListView.Text1->maxLength(), 26);

    // Enter and Escape do nothing, in the name box and on a focused button alike.
    QTest::keyClicks(w.newListView.Text1, QStringLiteral("Jazz"));
    QTest::keyClick(w.newListView.Text1, Qt::Key_Return);
    QTest::keyClick(w.newListView.Text1, Qt::Key_Escape);
    w.newListView.Command1->setFocus();
    QTest::keyClick(w.newListView.Command1, Qt::Key_Return);
    QTest::keyClick(w.newListView.Command1, Qt::Key_Enter);
    QTest::keyClick(w.newListView.Command2, Qt::Key_Escape);
    EXPECT_TRUE(dialog->isVisible());
    EXPECT_EQ(folder.get("pemla.dat"), "Pop\r\n");

    dialog->close();  // the close box
    EXPECT_FALSE(dialog->isVisible());
    EXPECT_TRUE(w.view.widget()->isEnabled());
    EXPECT_FALSE(folder.has("Jazz.dat"));

    // Opened again it starts empty; "Create" makes the list and closes.
    w.click(w.view.Command_create);
    EXPECT_EQ(w.newListView.Text1->text(), QString());
    QTest::keyClicks(w.newListView.Text1, QStringLiteral("Jazz"));
    QTest::mouseClick(w.newListView.Check_info, Qt::LeftButton);
    w.click(w.newListView.Command1);
    EXPECT_FALSE(dialog->isVisible());
    EXPECT_TRUE(w.view.widget()->isEnabled());
    EXPECT_EQ(folder.get("pemla.dat"), "Pop\r\nJazz\r\n");
    EXPECT_EQ(folder.get("Jazz.inf"), " 0 \r\n");
    EXPECT_EQ(w.view.List_list->count(), 2);

    // A refusal is told in a box, and the dialog closes all the same.
    w.click(w.view.Command_create);
    QTest::keyClicks(w.newListView.Text1, QStringLiteral("pop"));
    w.click(w.newListView.Command1);
    EXPECT_EQ(boxes.texts, QStringList{QStringLiteral("A list with that name already exist!")});
    EXPECT_EQ(boxes.titles, QStringList{QStringLiteral("Error")});
    EXPECT_FALSE(dialog->isVisible());
    EXPECT_TRUE(w.view.widget()->isEnabled());
}

TEST(DialogsOnQt, SearchDialogDisablesTheMainWindowUntilItCloses) {
    test_support::TempFolder folder;
    putCatalogue(folder);
    BoxRecorder boxes;
    QtWindows w(folder);
    QWidget* dialog = w.searchView.widget();

    w.select(w.view.List_list, QStringLiteral("Pop"));
    w.click(w.view.Command_search);
    expectOwnWindowAbove(dialog, w.view.widget());
    EXPECT_EQ(dialog->windowTitle(), QStringLiteral("Search article number"));
    EXPECT_EQ(dialog->focusWidget(), w.searchView.Text1);

    QTest::keyClicks(w.searchView.Text1, QStringLiteral("a0011"));
    EXPECT_EQ(w.searchView.Text1->text(), QStringLiteral("a001"));
    QTest::keyClick(w.searchView.Text1, Qt::Key_Return);
    QTest::keyClick(w.searchView.Text1, Qt::Key_Escape);
    EXPECT_EQ(w.searchView.Text2->text(), QString()) << "Enter does not search";
    EXPECT_TRUE(dialog->isVisible());
    w.click(w.searchView.Command_search);
    EXPECT_EQ(w.searchView.Text2->text(), QStringLiteral("Abba Gold"));
    EXPECT_TRUE(boxes.texts.isEmpty());

    dialog->close();  // the close box
    EXPECT_FALSE(dialog->isVisible());
    EXPECT_TRUE(w.view.widget()->isEnabled());

    // Without its article file the list cannot be searched: the box names the file, and the
    // dialog never stays open over a disabled main window.
    std::filesystem::remove(folder.file("Pop.art"));
    w.click(w.view.Command_search);
    ASSERT_EQ(boxes.texts.size(), 1);
    EXPECT_TRUE(boxes.texts[0].contains(QStringLiteral("\"Pop.art\"")))
        << boxes.texts[0].toStdString();
    EXPECT_FALSE(dialog->isVisible());
    EXPECT_TRUE(w.view.widget()->isEnabled());
}

}  // namespace
