// The whole program as main() builds it, driven offscreen only through its widgets: a list is
// created, filled, edited, searched, exported and deleted, and every file it leaves behind is
// compared byte for byte with files written out by hand.
#include <gtest/gtest.h>

#include <QFileSystemModel>
#include <QLabel>
#include <QProcess>
#include <QTest>
#include <QTreeView>
#include <QWindow>
#include <cstdlib>
#include <filesystem>

#include "app/program.h"
#include "tests/e2e/qt_user.h"
#include "tests/support/temp_folder.h"

namespace {

using namespace qt_user;
namespace fs = std::filesystem;

const std::string kData = PEMLA_E2E_DATA;

// Compares `folder` with the expected folder: the same file names and the same bytes. In
// export.dat the token @OUTPUT@ stands for the output folder, which only the test knows.
void expectFolder(const std::string& folder, const std::string& expectedFolder,
                  const std::string& output = {}) {
    test_support::Files expected = test_support::snapshot(kData + "/" + expectedFolder);
    if (auto settings = expected.find("export.dat"); settings != expected.end()) {
        settings->second.replace(settings->second.find("@OUTPUT@"), 8, output);
    }
    EXPECT_EQ(test_support::snapshot(folder), expected) << expectedFolder;
}

// A dialog is a window of its own above the main window, not one of its children, so that
// disabling the main window leaves the dialog usable; it opens with the focus on its text box.
void expectOwnWindowAbove(QWidget* dialog, QWidget* main, QWidget* focus, const char* title) {
    EXPECT_TRUE(dialog->isVisible() && dialog->isWindow() && dialog->isEnabled());
    EXPECT_EQ(dialog->parentWidget(), nullptr);
    ASSERT_NE(dialog->windowHandle(), nullptr);
    EXPECT_EQ(dialog->windowHandle()->transientParent(), main->windowHandle());
    EXPECT_FALSE(main->isEnabled());
    EXPECT_EQ(dialog->windowTitle(), QString::fromLatin1(title));
    EXPECT_EQ(dialog->focusWidget(), focus);
}

TEST(ProgramEndToEnd, CreateFillEditSearchExportAndDeleteAList) {
    test_support::TempFolder work, home;
    ::setenv("HOME", home.path().c_str(), 1);  // the export dialog's first output folder
    const std::string reports = home.file("reports");
    fs::create_directory(reports);
    fs::copy(kData + "/start", work.path());

    Boxes boxes;
    ui::qt::QtPlatform platform;
    app::Program program(work.path(), platform);
    app::MainWindowView& main = program.mainWindow();
    program.start();
    EXPECT_EQ(main.widget()->windowTitle(), QStringLiteral("Pemla 0.90Beta"));
    ASSERT_EQ(rows(main.List_list), 1);

    // The real program started a second time on this folder ends with its message and status 3,
    // writing nothing, and this window goes on. The second copy runs on a display of its own,
    // where xdotool answers its "Error" box; a copy that opened its main window instead is ended
    // after 30 seconds, and the test fails.
    QProcess second;
    QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
    environment.remove(QStringLiteral("QT_QPA_PLATFORM"));
    second.setProcessEnvironment(environment);
    second.start(QStringLiteral("timeout"),
                 {"-k", "5", "30", "xvfb-run", "-a", "sh", "-c",
                  "\"$0\" --data \"$1\" & id=$(timeout 25 xdotool search --sync --onlyvisible "
                  "--name '^Error$' | head -n 1) && xdotool windowfocus --sync \"$id\" key Return; "
                  "wait $!",
                  PEMLA_BINARY, QString::fromStdString(work.path())});
    ASSERT_TRUE(second.waitForFinished(50000)) << "the second copy did not end";
    EXPECT_EQ(std::pair(second.exitStatus(), second.exitCode()), std::pair(QProcess::NormalExit, 3))
        << "124 or 137: the second copy ran on for 30 seconds; "
        << second.readAllStandardError().toStdString();
    expectFolder(work.path(), "start");

    // A new list, with its information column. Enter and Escape do nothing, in the name box and
    // on a focused button alike; the close box gives the main window back.
    click(main.Command_create);
    app::NewListView& newList = program.newListDialog();
    expectOwnWindowAbove(newList.widget(), main.widget(), newList.Text1, "Create new list");
    EXPECT_EQ(newList.Text1->maxLength(), 26);
    QTest::keyClicks(newList.Text1, QStringLiteral("Jazz"));
    QTest::keyClick(newList.Text1, Qt::Key_Return);
    QTest::keyClick(newList.Text1, Qt::Key_Escape);
    newList.Command1->setFocus();
    QTest::keyClick(newList.Command1, Qt::Key_Return);
    QTest::keyClick(newList.Command1, Qt::Key_Enter);
    QTest::keyClick(newList.Command2, Qt::Key_Escape);
    ASSERT_TRUE(newList.widget()->isVisible());
    newList.widget()->close();
    ASSERT_TRUE(!newList.widget()->isVisible() && main.widget()->isEnabled());
    click(main.Command_create);
    retype(newList.Text1, "Films");
    click(newList.Command1);
    ASSERT_TRUE(main.widget()->isEnabled());
    pick(main.List_list, QStringLiteral("Films"));
    ASSERT_EQ(rows(main.List1), 1);

    // Three entries.
    const char* added[][4] = {{"Am\xe9lie", "DVD video", "1", "Original"},
                              {"Brazil", "Blu-ray video", "2", "Copy"},
                              {"Casablanca", "DVD video", "1", "Boxed"}};
    QWidget* const fields[] = {main.Text1, main.Combo1, main.Combo2, main.Combo3};
    for (const auto& entry : added) {
        for (int i = 0; i < 4; ++i) retype(fields[i], entry[i]);
        click(main.Command_add);
    }
    ASSERT_EQ(rows(main.List1), 4);
    EXPECT_EQ(main.Label2->text(), QStringLiteral("... amount:  4 ..."));
    // After the reset, Down starts again at the first suggestion.
    QTest::keyClick(main.Combo1, Qt::Key_Down);
    EXPECT_EQ(main.Combo1->currentText(), QStringLiteral("DVD video"));

    // Brazil becomes a title of another letter: it gets a new article number.
    pick(main.List1, QStringLiteral("Brazil"));
    EXPECT_EQ(main.Textart->text(), QStringLiteral("B001"));
    retype(main.Text1, "Zazie dans le m\xe9tro");
    retype(main.Combo1, "DVD video");
    retype(main.Combo3, "Signed");
    click(main.Command_change);
    EXPECT_EQ(boxes.take(), Shown{"Change item: Are ya sure yo want to change selected entry?"});
    pick(main.List1, QString::fromLatin1("Zazie dans le m\xe9tro"));
    EXPECT_EQ(main.Textart->text(), QStringLiteral("Z001"));

    pick(main.List1, QStringLiteral("Casablanca"));
    click(main.Command_delentry);
    EXPECT_EQ(boxes.take(), Shown{"Change item: Are ya sure yo want to DELETE selected entry?"});
    EXPECT_EQ(rows(main.List1), 3);

    // The search finds the changed title by its number, typed in small letters; the box takes
    // four characters, and Enter does not search.
    click(main.Command_search);
    app::SearchView& search = program.searchDialog();
    expectOwnWindowAbove(search.widget(), main.widget(), search.Text1, "Search article number");
    QTest::keyClicks(search.Text1, QStringLiteral("z0011"));
    QTest::keyClick(search.Text1, Qt::Key_Return);
    QTest::keyClick(search.Text1, Qt::Key_Escape);
    EXPECT_EQ(search.Text2->text(), QString());
    click(search.Command_search);
    EXPECT_EQ(search.Text2->text(), QString::fromLatin1("Zazie dans le m\xe9tro"));
    search.widget()->close();
    ASSERT_TRUE(main.widget()->isEnabled());

    // Export: first as text with article numbers and the last two added below the table.
    click(main.Command_export);
    app::ExportView& exporter = program.exportDialog();
    ASSERT_TRUE(exporter.widget()->isVisible());
    EXPECT_EQ(exporter.controls().Dir1.path(), home.path());
    auto* folders = static_cast<QFileSystemModel*>(exporter.Dir1->model());
    exporter.Dir1->setCurrentIndex(folders->index(QString::fromStdString(reports)));
    ASSERT_EQ(exporter.controls().Dir1.path(), reports);
    for (QCheckBox* box :
         {exporter.Checkart, exporter.Checkline, exporter.Checkcounter, exporter.Check_lastadd}) {
        click(box);
    }
    retype(exporter.Text2, "2");
    exporter.Combo1->setFocus();
    QTest::keyClick(exporter.Combo1, Qt::Key_Down);
    EXPECT_EQ(exporter.Combo1->currentText(), QStringLiteral("Bottom"));
    click(exporter.Command1);
    EXPECT_EQ(boxes.take(), Shown{"Done: Export done!"});

    // Then as an HTML page without article numbers, the last two added on top.
    click(exporter.Checkart);
    click(exporter.Checkhtml);
    QTest::keyClick(exporter.Combo1, Qt::Key_Up);
    click(exporter.Command1);
    EXPECT_EQ(boxes.take(), Shown{"Done: Export done!"});
    click(exporter.Command2);
    ASSERT_TRUE(main.widget()->isEnabled());

    expectFolder(work.path(), "before-delete", reports);
    expectFolder(reports, "out");

    // The list goes, after two confirmations; the other list stays as it was.
    pick(main.List_list, QStringLiteral("Films"));
    click(main.Command_delete);
    EXPECT_EQ(boxes.take(), (Shown{"DELETE?: ARE YA SURE YA WANT TO DELETE THE SELECTED LIST?",
                                   "DELETE?: ARE YA REALLY SURE?"}));
    ASSERT_EQ(rows(main.List_list), 1);
    EXPECT_EQ(rows(main.List1), 0);

    expectFolder(work.path(), "end", reports);
    EXPECT_EQ(boxes.take(), Shown{});

    // Without its article file a list cannot be searched: the box names the file, and the
    // dialog never stays open over a disabled main window.
    fs::remove(work.file("Games.art"));
    pick(main.List_list, QStringLiteral("Games"));
    click(main.Command_search);
    const Shown shown = boxes.take();
    ASSERT_EQ(shown.size(), 1u);
    EXPECT_NE(shown[0].find("\"Games.art\""), std::string::npos) << shown[0];
    EXPECT_TRUE(!search.widget()->isVisible() && main.widget()->isEnabled());
}

}  // namespace
