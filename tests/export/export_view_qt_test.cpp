// The export dialog on Qt, opened from the real main window and driven through its widgets.
#include <gtest/gtest.h>

#include <QApplication>
#include <QCheckBox>
#include <QComboBox>
#include <QFileSystemModel>
#include <QLineEdit>
#include <QListWidget>
#include <QMessageBox>
#include <QPushButton>
#include <QTest>
#include <QTreeView>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <sstream>

#include "app/export_view.h"
#include "app/main_window_view.h"
#include "catalogue/store.h"
#include "export/form_export.h"
#include "main_window/form1.h"
#include "tests/support/temp_folder.h"
#include "ui/qt/qt_platform.h"

namespace {

std::string data(const std::string& name) {
    std::ifstream in(std::string(PEMLA_EXPORT_DATA) + "/" + name, std::ios::binary);
    std::ostringstream bytes;
    bytes << in.rdbuf();
    return bytes.str();
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

    catalogue::Store store(folder.path());
    ui::qt::QtPlatform platform;
    app::MainWindowView mainView;
    main_window::Form1 form1(mainView.controls(), platform, store);
    app::ExportView exportView(mainView.widget());
    exporting::Form_Export formExport(exportView.controls(), platform, store, form1);
    form1.setDialogs({nullptr, &exportView.controls().window, nullptr});

    // Every box must take the user's answer: none may sit on a disabled window.
    std::vector<std::string> boxes;
    ui::qt::QtPlatform::setAnswerHook([&boxes](QMessageBox& box) {
        boxes.push_back(box.windowTitle().toStdString() + ": " + box.text().toStdString());
        EXPECT_TRUE(box.isEnabled()) << boxes.back();
        return ui::Answer::Ok;
    });

    mainView.controls().window.show();
    ASSERT_FALSE(platform.ended());
    mainView.List_list->setCurrentRow(0);  // the user picks "Movies"
    ASSERT_EQ(mainView.List1->count(), 10);

    QTest::mouseClick(mainView.Command_export, Qt::LeftButton);
    QWidget* dialog = exportView.widget();
    ASSERT_TRUE(dialog->isVisible());
    EXPECT_EQ(dialog->windowTitle(), QStringLiteral("Export list"));
    EXPECT_EQ(dialog->parentWidget(), nullptr);
    EXPECT_FALSE(mainView.widget()->isEnabled());
    EXPECT_TRUE(dialog->isEnabled());
    EXPECT_TRUE(exportView.Command1->isEnabled());
    EXPECT_FALSE(exportView.Check_noinfo->isVisible());
    EXPECT_FALSE(exportView.Text1->isVisible());
    EXPECT_EQ(exportView.Combo1->currentText(), QStringLiteral("Top"));
    EXPECT_EQ(exportView.controls().Dir1.path(), home.path());

    // The user picks the output folder in the folder list and exports as text.
    auto* model = static_cast<QFileSystemModel*>(exportView.Dir1->model());
    exportView.Dir1->setCurrentIndex(model->index(QString::fromStdString(out.path())));
    ASSERT_EQ(exportView.controls().Dir1.path(), out.path());
    QTest::mouseClick(exportView.Command1, Qt::LeftButton);
    EXPECT_EQ(boxes, std::vector<std::string>{"Done: Export done!"});
    const std::string text = out.get("Movies.TXT");
    EXPECT_TRUE(text.starts_with(".[Movies]")) << text.substr(0, 80);
    EXPECT_NE(text.find("| Star Wars                  | DVD video         |   2    | Copy"),
              std::string::npos);
    EXPECT_TRUE(
        text.ends_with(std::string(36, ' ') + std::string(exporting::kCreditText) + "\r\n\r\n"));
    EXPECT_TRUE(dialog->isEnabled());

    // Then as an HTML page.
    QTest::mouseClick(exportView.Checkhtml, Qt::LeftButton);
    ASSERT_TRUE(exportView.Checkhtml->isChecked());
    QTest::mouseClick(exportView.Command1, Qt::LeftButton);
    const std::string page = out.get("Movies.html");
    EXPECT_TRUE(page.starts_with("<html>\r\n<head>\r\n<title>Movies</title>\r\n")) << page;
    EXPECT_NE(page.find("\r\n&gt;----------------------------+"), std::string::npos);
    EXPECT_EQ(boxes.size(), 2u);

    // Too many last added titles: the refusal clears the box, and the export goes on without it.
    QApplication::setActiveWindow(dialog);  // as when the user works in it; boxes sit on it
    ASSERT_EQ(QApplication::activeWindow(), dialog);
    QTest::mouseClick(exportView.Check_lastadd, Qt::LeftButton);
    exportView.Text2->clear();
    exportView.Text2->setFocus();
    QTest::keyClicks(exportView.Text2, QStringLiteral("123"));
    EXPECT_EQ(exportView.Text2->text(), QStringLiteral("12"));
    QTest::mouseClick(exportView.Command1, Qt::LeftButton);
    ASSERT_EQ(boxes.size(), 4u);
    EXPECT_EQ(boxes[2], "ERROR!: More last add's than titels!\nExport the list without lastadd's");
    EXPECT_EQ(boxes[3], "Done: Export done!");
    EXPECT_FALSE(exportView.Check_lastadd->isChecked());

    // The close box saves the settings and gives the main window back.
    dialog->close();
    EXPECT_FALSE(dialog->isVisible());
    EXPECT_TRUE(mainView.widget()->isEnabled());
    EXPECT_EQ(folder.get("export.dat"),
              out.path() + "\r\n 0 \r\n 1 \r\n 0 \r\n 0 \r\n 0 \r\n 0 \r\n12\r\nTop\r\n");
    ui::qt::QtPlatform::setAnswerHook(nullptr);
}

}  // namespace
