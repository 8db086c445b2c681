// The export dialog on Qt, opened from the real main window and driven through its widgets.
#include <gtest/gtest.h>

#include <QFileSystemModel>
#include <QTest>
#include <QTreeView>
#include <cstdlib>
#include <filesystem>

#include "app/program.h"
#include "tests/e2e/qt_user.h"
#include "tests/export/export_fixture.h"

namespace {

using export_test::data;

TEST(ExportDialogOnQt, ExportsToAnyFolderAndSavesItOnTheCloseBox) {
    test_support::TempFolder folder, home, out;
    // A localized home folder, and a list whose Latin-1 name has its files under UTF-8 names.
    const std::string homeFolder = home.file("M\xC3\xBAsica");
    std::filesystem::create_directory(homeFolder);
    ::setenv("HOME", homeFolder.c_str(), 1);
    test_support::putMusicCatalogue(folder);
    folder.put("pemla.dat", "Canci\xF3nes\r\n");
    folder.putList("Canci\xC3\xB3nes", data("movies.dat"), data("movies.art"), "A#003\r\n");

    ui::qt::QtPlatform platform;
    app::Program program(folder.path(), platform);
    app::MainWindowView& mainView = program.mainWindow();
    app::ExportView& view = program.exportDialog();

    // Every box must take the user's answer: none may sit on a disabled window.
    qt_user::Boxes boxes;
    program.start();
    mainView.List_list->setCurrentIndex(
        mainView.List_list->model()->index(0, 0));  // the user picks the list
    QTest::mouseClick(mainView.Command_export, Qt::LeftButton);
    QWidget* dialog = view.widget();
    ASSERT_TRUE(dialog->isVisible());
    EXPECT_EQ(dialog->windowTitle(), QStringLiteral("Export list"));
    EXPECT_FALSE(mainView.widget()->isEnabled());
    EXPECT_FALSE(view.Check_noinfo->isVisible());
    EXPECT_FALSE(view.Text1->isVisible());
    EXPECT_EQ(view.controls().Dir1.path(), homeFolder);

    // The close box gives the main window back; the folder list and the settings file carry
    // any folder name the system allows, and reopening finds it again.
    auto* model = static_cast<QFileSystemModel*>(view.Dir1->model());
    QTest::mouseClick(view.Checkhtml, Qt::LeftButton);
    dialog->close();
    EXPECT_TRUE(mainView.widget()->isEnabled());
    for (const std::string name :
         {"M\xC3\xBCsik",
          "\xD0\x94\xD0\xBE\xD0\xBA\xD1\x83\xD0\xBC\xD0\xB5\xD0\xBD\xD1\x82\xD1\x8B",
          "\xE9\x9F\xB3\xE6\xA5\xBD", "a, \"b\"", " lead"}) {
        SCOPED_TRACE(name);
        const std::string chosen = out.file(name);
        std::filesystem::create_directory(chosen);
        for (int opening = 0; opening < 2; ++opening) {
            QTest::mouseClick(mainView.Command_export, Qt::LeftButton);
            if (opening == 0) view.Dir1->setCurrentIndex(model->index(QString::fromUtf8(chosen)));
            EXPECT_EQ(view.controls().Dir1.path(), chosen);
            QTest::mouseClick(view.Command1, Qt::LeftButton);
            dialog->close();
        }
        EXPECT_TRUE(out.get(name + "/Canci\xC3\xB3nes.html").starts_with("<html>"));
    }
    EXPECT_EQ(boxes.take(), std::vector<std::string>(10, "Done: Export done!"));
}

}  // namespace
