// The program's four windows on Qt as a user with a large window, large fonts, a keyboard or a
// screen reader meets them.
#include <gtest/gtest.h>

#include <QAbstractButton>
#include <QAbstractScrollArea>
#include <QAccessible>
#include <QApplication>
#include <QComboBox>
#include <QImage>
#include <QLineEdit>
#include <QListView>
#include <QTest>
#include <QTimer>

#include "app/program.h"
#include "app/start_up.h"
#include "tests/support/temp_folder.h"

namespace {

// Each with a folder of its own: a second program on a folder that one holds would refuse to start.
struct Windows {
    Windows() : program(filled(files), platform) {
        program.start();
        QListView* lists = program.mainWindow().List_list;
        const auto music = lists->model()->match(lists->model()->index(0, 0), Qt::DisplayRole,
                                                 "Music", 1, Qt::MatchExactly);
        lists->setCurrentIndex(music.front());  // opens the list
    }
    static const std::string& filled(const test_support::TempFolder& files) {
        test_support::putMusicCatalogue(files);
        files.put("type.dat", "Types\r\nAn uncommonly long type of disc, longer than any box\r\n");
        return files.path();
    }
    // Every window, each shown (and so loaded, with its captions).
    std::vector<QWidget*> all() {
        program.newListDialog().controls().window.show();
        program.searchDialog().controls().window.show();
        program.exportDialog().controls().window.show();
        return {program.mainWindow().widget(), program.newListDialog().widget(),
                program.searchDialog().widget(), program.exportDialog().widget()};
    }

    test_support::TempFolder files;
    ui::qt::QtPlatform platform;
    app::Program program;
};

// The visible controls of a window, without the parts that list and combo boxes are made of.
std::vector<QWidget*> controlsOf(QWidget* window) {
    std::vector<QWidget*> controls;
    for (QWidget* w : window->findChildren<QWidget*>()) {
        bool part = false;
        for (QWidget* up = w->parentWidget(); up != window; up = up->parentWidget()) {
            part = part || up->inherits("QAbstractScrollArea") || up->inherits("QComboBox");
        }
        if (!part && w->isVisibleTo(window)) controls.push_back(w);
    }
    return controls;
}

TEST(Windows, TheMainWindowGrowsAndItsListsTakeTheRoom) {
    Windows w;
    app::MainWindowView& view = w.program.mainWindow();
    const int lists = view.List_list->width(), titles = view.List1->width();
    view.widget()->resize(1200, 800);
    QApplication::processEvents();
    EXPECT_GT(view.List_list->width(), lists);
    EXPECT_GT(view.List1->width() - titles, view.List_list->width() - lists);
    EXPECT_GT(view.List1->height(), 500);
    const std::vector<QWidget*> controls = controlsOf(view.widget());
    for (QWidget* a : controls) {
        for (QWidget* b : controls) {
            EXPECT_TRUE(a == b || a->isAncestorOf(b) || b->isAncestorOf(a) ||
                        !a->geometry().intersects(b->geometry()))
                << a->objectName().toStdString() << a->metaObject()->className() << " and "
                << b->metaObject()->className();
        }
    }

    // It carries the program's picture, drawn from the built-in file.
    const QImage icon = app::programIcon().pixmap(32).toImage();
    EXPECT_GT(qAlpha(icon.pixel(16, 16)), 0);

    // Its size and place are kept for the next start.
    test_support::TempFolder config;
    app::saveWindowPlace(view.widget(), config.file("pemla/window"));
    Windows next;
    app::restoreWindowPlace(next.program.mainWindow().widget(), config.file("pemla/window"));
    EXPECT_EQ(next.program.mainWindow().widget()->size(), QSize(1200, 800));
}

// At 14 points no control is smaller than it needs; every control has a name for screen readers
// and every button an access key of its own.
TEST(Windows, At14PointsEveryControlFitsAndHasANameAndEveryButtonAnAccessKey) {
    const QFont normal = QApplication::font();
    QApplication::setFont(QFont(QStringLiteral("DejaVu Sans"), 14));
    {
        Windows w;
        for (QWidget* window : w.all()) {
            QApplication::processEvents();
            std::set<int> keys;
            for (QWidget* control : controlsOf(window)) {
                const std::string where = std::string(control->metaObject()->className()) + " in " +
                                          window->windowTitle().toStdString();
                const QSize hint = control->sizeHint();
                EXPECT_TRUE(
                    control->inherits("QAbstractScrollArea") || !hint.isValid() ||
                    (control->width() >= hint.width() && control->height() >= hint.height()))
                    << where << ": " << control->width() << "x" << control->height() << " < "
                    << hint.width() << "x" << hint.height();  // scroll areas scroll
                if (!control->inherits("QAbstractButton") && !control->inherits("QLineEdit") &&
                    !control->inherits("QComboBox") && !control->inherits("QAbstractItemView")) {
                    continue;
                }
                // Buttons are named by their captions; a combo box would otherwise be named by
                // its current text, so the others need a name of their own.
                auto* button = qobject_cast<QAbstractButton*>(control);
                const QString name =
                    button ? QAccessible::queryAccessibleInterface(control)->text(QAccessible::Name)
                           : control->accessibleName();
                EXPECT_FALSE(name.trimmed().isEmpty()) << where;
                if (button != nullptr) {
                    const int key = QKeySequence::mnemonic(button->text())[0].toCombined();
                    EXPECT_NE(key, 0) << name.toStdString();
                    EXPECT_TRUE(keys.insert(key).second) << "a second " << name.toStdString();
                }
            }
        }
    }
    QApplication::setFont(normal);
    // Ctrl+Q does what Exit does (while no dialog has the main window disabled): the program's
    // event loop ends with status 0. One that goes on is ended by the guard with 99.
    Windows fresh;
    QTimer guard;
    QObject::connect(&guard, &QTimer::timeout, [] { QApplication::exit(99); });
    guard.start(5000);
    QTimer::singleShot(0, [&fresh] {
        QApplication::setActiveWindow(fresh.program.mainWindow().widget());
        QTest::keyClick(fresh.program.mainWindow().widget(), Qt::Key_Q, Qt::ControlModifier);
    });
    EXPECT_EQ(QApplication::exec(), 0);
    EXPECT_TRUE(fresh.platform.ended());
    ui::qt::QtWindow::setEnding(false);
}

}  // namespace
