// The real main window on Qt, driven through its widgets: the largest list's speed and keys, and a
// start that fails; the handlers' file effects are proven on the memory controls and in the
// end-to-end run, which also starts a second real copy.
#include <gtest/gtest.h>

#include <QElapsedTimer>
#include <QTest>
#include <iostream>

#include "app/program.h"
#include "bench/catalogue_maker.h"
#include "tests/e2e/qt_user.h"
#include "tests/support/temp_folder.h"
#include "ui/qt/qt_platform.h"

namespace {

using qt_user::pick;
using qt_user::rows;
using qt_user::rowText;

// The program on a folder, its main window shown.
struct QtMainWindow {
    explicit QtMainWindow(const test_support::TempFolder& folder)
        : program(folder.path(), platform), view(program.mainWindow()) {
        program.start();
    }
    ui::qt::QtPlatform platform;
    app::Program program;
    app::MainWindowView& view;
};

TEST(MainWindowOnQt, TheLargestListOpensAndFindsQuickly) {
    test_support::TempFolder folder;
    bench::writeCatalogue(folder.path(), "Big");
    bench::writeList(folder.path(), "Big", 32767);
    QtMainWindow w(folder);
    QElapsedTimer timer;
    timer.start();
    pick(w.view.List_list, QStringLiteral("Big"));
    const qint64 openMs = timer.elapsed();
    ASSERT_EQ(rows(w.view.List1), 32767);
    timer.restart();
    pick(w.view.List1, rowText(w.view.List1, 20000));
    const qint64 selectMs = timer.elapsed();

    // The "Find title" box: a key searches every row (each title holds a space); F3 and
    // Shift+F3 step and wrap.
    w.view.widget()->activateWindow();
    ASSERT_TRUE(QTest::qWaitForWindowActive(w.view.widget()));
    timer.restart();
    qt_user::retype(w.view.Text_find, " ");
    const qint64 keyMs = timer.elapsed();
    std::vector<int> rows = {w.view.List1->currentIndex().row()};
    for (auto modifier : {Qt::ShiftModifier, Qt::NoModifier}) {
        QTest::keyClick(w.view.Text_find, Qt::Key_F3, modifier);
        rows.push_back(w.view.List1->currentIndex().row());
    }
    EXPECT_EQ(rows, (std::vector<int>{0, 32766, 0}));
    EXPECT_EQ(w.view.Text1->text(), rowText(w.view.List1, 0));
    std::cout << "32767 entries on Qt: open " << openMs << " ms, select " << selectMs
              << " ms, find key " << keyMs << " ms\n";
    // Generous bounds that still catch work growing with the square of the list.
    EXPECT_LT(openMs, 3000);
    EXPECT_LT(selectMs, 1000);
    EXPECT_LT(keyMs, 1000);
}

TEST(MainWindowOnQt, AMissingFileStopsTheStartWithAMessage) {
    test_support::TempFolder folder;
    folder.put("type.dat", "Types\r\n");
    folder.put("pemla.dat", "");
    qt_user::Boxes boxes;
    {
        QtMainWindow w(folder);
        EXPECT_EQ(std::pair(w.platform.ended(), w.platform.status()), std::pair(true, 1));
        EXPECT_FALSE(w.view.widget()->isVisible());
    }
    ui::qt::QtWindow::setEnding(false);
    EXPECT_EQ(boxes.shown.size(), 1u);  // what it says is the window logic's, tested there
}

}  // namespace
