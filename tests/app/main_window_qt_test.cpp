// The real main window on Qt, driven through its widgets: what only the Qt side does (key
// wiring, what the widgets show, a second running copy, the largest list's speed), while the
// handlers' file effects are proven on the memory controls and in the end-to-end run.
#include <gtest/gtest.h>

#include <QElapsedTimer>
#include <QLabel>
#include <QProcess>
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

// The real program started a second time on the folder this window holds ends with its message
// and status 3, writing nothing; this window then adds through its widgets as before. The second
// copy runs on a display of its own, where xdotool answers its "Error" box; a copy that opened
// its main window instead is ended after 30 seconds, and the test fails. Every box this window
// shows is answered and kept, so that a fault shows as a failure, never as a wait for a user.
TEST(MainWindowOnQt, ASecondRealCopyEndsAndTheFirstStillAddsThroughItsWidgets) {
    test_support::TempFolder folder;
    test_support::putMusicCatalogue(folder);
    qt_user::Boxes boxes;
    QtMainWindow w(folder);
    EXPECT_EQ(w.view.widget()->windowTitle(), QStringLiteral("Pemla 0.90Beta"));
    const std::string before = folder.listing() + folder.get("Music.dat") + folder.get("pemla.dat");
    QProcess second;
    QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
    environment.remove(QStringLiteral("QT_QPA_PLATFORM"));
    second.setProcessEnvironment(environment);
    second.start(QStringLiteral("timeout"),
                 {"-k", "5", "30", "xvfb-run", "-a", "sh", "-c",
                  "\"$0\" --data \"$1\" & id=$(timeout 25 xdotool search --sync --onlyvisible "
                  "--name '^Error$' "
                  "| head -n 1) && xdotool windowfocus --sync \"$id\" key Return; wait $!",
                  PEMLA_BINARY, QString::fromStdString(folder.path())});
    ASSERT_TRUE(second.waitForFinished(50000)) << "the second copy did not end";
    EXPECT_EQ(second.exitStatus(), QProcess::NormalExit);
    EXPECT_EQ(second.exitCode(), 3) << "124 or 137: the second copy ran on for 30 seconds; "
                                    << second.readAllStandardError().toStdString();
    EXPECT_EQ(folder.listing() + folder.get("Music.dat") + folder.get("pemla.dat"), before);

    // "2" typed over the selected "Disc(s)" fits the box's limit of six.
    pick(w.view.List_list, QStringLiteral("Music"));
    qt_user::retype(w.view.Text1, "Abbey Road");
    w.view.Combo1->setCurrentIndex(0);
    w.view.Combo2->lineEdit()->selectAll();
    QTest::keyClicks(w.view.Combo2, QStringLiteral("2"));
    qt_user::click(w.view.Command_add);
    EXPECT_EQ(folder.get("Music.dat"),
              "<|?Zebra\r\n<|'Music CD\r\n<||1\r\n<|*Original\r\n"
              "<|?Abbey Road\r\n<|'Music CD\r\n<||2\r\n<|*Info\r\n");
    EXPECT_EQ(w.view.Label2->text(), QStringLiteral("... amount:  2 ..."));
    // After the reset, Down starts again at the first suggestion.
    QTest::keyClick(w.view.Combo1, Qt::Key_Down);
    EXPECT_EQ(w.view.Combo1->currentText(), QStringLiteral("Music CD"));
    EXPECT_EQ(boxes.take(), qt_user::Shown{});
}

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
