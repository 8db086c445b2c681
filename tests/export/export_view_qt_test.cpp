// The export dialog on Qt, opened from the real main window and driven through its widgets.
#include <gtest/gtest.h>

#include <QApplication>
#include <QCheckBox>
#include <QFileSystemModel>
#include <QLineEdit>
#include <QListWidget>
#include <QMessageBox>
#include <QPushButton>
#include <QTest>
#include <QTreeView>
#include <cstdlib>
#include <fstream>
#include <iterator>

#include "app/program.h"
#include "tests/support/temp_folder.h"
#include "ui/qt/qt_platform.h"

namespace {

std::string data(const std::string& name) {
    std::ifstream in(std::string(PEMLA_EXPORT_DATA) + "/" + name, std::ios::binary);
    return {std::istreambuf_iterator<char>(in), {}};
}

TEST(ExportDialogOnQt, ExportsTextAndHtmlAndSavesOnTheCloseBox) {
    test_support::TempFolder folder;
    test_support::TempFolder home;
    test_support::TempFolder out;
    ::setenv("HOME", home.path().c_str(), 1);
    folder.put("type.dat", "Types\r\nMusic CD\r\n");
    folder.put("information.dat", "Information\r\nOriginal\r\n");
    folder.put("pemla.dat", "Movies\r\n");
    folder.put("Movies.dat", data("movies.dat"));
    folder.put("Movies.art", data("movies.art"));
    folder.put("Movies.arn", "A#003\r\n");
    folder.put("Movies.inf", " 1 \r\n");

    ui::qt::QtPlatform platform;
    app::Program program(folder.path(), platform);
    app::MainWindowView& mainView = program.mainWindow();
    app::ExportView& view = program.exportDialog();

    // Every box must take the user's answer: none may sit on a disabled window.
    std::vector<std::string> boxes;
    ui::qt::QtPlatform::setAnswerHook([&boxes](QMessageBox& box) {
        boxes.push_back(box.windowTitle().toStdString() + ": " + box.text().toStdString());
        EXPECT_TRUE(box.isEnabled()) << boxes.back();
        return ui::Answer::Ok;
    });

    program.start();
    mainView.List_list->setCurrentRow(0);  // the user picks "Movies"
    ASSERT_EQ(mainView.List1->count(), 10);
    QTest::mouseClick(mainView.Command_export, Qt::LeftButton);
    QWidget* dialog = view.widget();
    ASSERT_TRUE(dialog->isVisible());
    EXPECT_EQ(dialog->windowTitle(), QStringLiteral("Export list"));
    EXPECT_FALSE(mainView.widget()->isEnabled());
    EXPECT_FALSE(view.Check_noinfo->isVisible());
    EXPECT_FALSE(view.Text1->isVisible());
    EXPECT_EQ(view.controls().Dir1.path(), home.path());

    // The user picks the output folder in the folder list and exports as text, then as HTML.
    auto* model = static_cast<QFileSystemModel*>(view.Dir1->model());
    view.Dir1->setCurrentIndex(model->index(QString::fromStdString(out.path())));
    ASSERT_EQ(view.controls().Dir1.path(), out.path());
    QTest::mouseClick(view.Command1, Qt::LeftButton);
    EXPECT_TRUE(out.get("Movies.TXT").starts_with(".[Movies]"));
    QTest::mouseClick(view.Checkhtml, Qt::LeftButton);
    QTest::mouseClick(view.Command1, Qt::LeftButton);
    EXPECT_TRUE(out.get("Movies.html").starts_with("<html>\r\n<head>\r\n<title>Movies</title>"));
    EXPECT_EQ(boxes, std::vector<std::string>(2, "Done: Export done!"));
    EXPECT_TRUE(dialog->isEnabled());

    // Too many last added titles: the refusal clears the box, and the export goes on without it.
    QApplication::setActiveWindow(dialog);  // as when the user works in it; boxes sit on it
    ASSERT_EQ(QApplication::activeWindow(), dialog);
    QTest::mouseClick(view.Check_lastadd, Qt::LeftButton);
    view.Text2->clear();
    QTest::keyClicks(view.Text2, QStringLiteral("123"));
    QTest::mouseClick(view.Command1, Qt::LeftButton);
    ASSERT_EQ(boxes.size(), 4u);
    EXPECT_EQ(boxes[2], "ERROR!: More last add's than titels!\nExport the list without lastadd's");
    EXPECT_EQ(boxes[3], "Done: Export done!");
    EXPECT_FALSE(view.Check_lastadd->isChecked());

    // The close box saves the settings, the amount cut to two characters, and gives the main
    // window back.
    dialog->close();
    EXPECT_FALSE(dialog->isVisible());
    EXPECT_TRUE(mainView.widget()->isEnabled());
    EXPECT_EQ(folder.get("export.dat"),
              out.path() + "\r\n 0 \r\n 1 \r\n 0 \r\n 0 \r\n 0 \r\n 0 \r\n12\r\nTop\r\n");
    ui::qt::QtPlatform::setAnswerHook(nullptr);
}

}  // namespace
