#pragma once
// A user's hands on the program's Qt widgets, and the message boxes the user answers: shared by
// the suites that drive the real windows offscreen.
#include <gtest/gtest.h>

#include <QAbstractButton>
#include <QCheckBox>
#include <QComboBox>
#include <QLineEdit>
#include <QListView>
#include <QMessageBox>
#include <QPushButton>
#include <QTest>
#include <string>
#include <utility>
#include <vector>

#include "ui/qt/qt_controls.h"
#include "ui/qt/qt_platform.h"

namespace qt_user {

// Answers every message box as a user going on does (Yes, or OK) and keeps it as "title: text";
// a box the user could not click fails the test.
struct Boxes {
    Boxes() {
        ui::qt::QtPlatform::setAnswerHook([this](QMessageBox& box) {
            shown.push_back(ui::qt::fromQt(box.windowTitle() + ": " + box.text()));
            EXPECT_TRUE(box.isEnabled()) << shown.back();
            return box.button(QMessageBox::Yes) ? ui::Answer::Yes : ui::Answer::Ok;
        });
    }
    ~Boxes() { ui::qt::QtPlatform::setAnswerHook(nullptr); }
    // The boxes shown since the last call.
    std::vector<std::string> take() { return std::exchange(shown, {}); }
    std::vector<std::string> shown;
};
using Shown = std::vector<std::string>;

// A user's hands on the program's widgets.
inline void click(QAbstractButton* button) {
    ASSERT_TRUE(button->isVisible() && button->isEnabled()) << button->text().toStdString();
    QTest::mouseClick(button, Qt::LeftButton);
}

// What a list shows: its number of rows and one row's text.
inline int rows(const QListView* list) {
    return list->model()->rowCount();
}
inline QString rowText(const QListView* list, int row) {
    return list->model()->index(row, 0).data().toString();
}

inline void pick(QListView* list, const QString& text) {
    const auto found = list->model()->match(list->model()->index(0, 0), Qt::DisplayRole, text, -1,
                                            Qt::MatchExactly);
    ASSERT_EQ(found.size(), 1) << text.toStdString();
    list->scrollTo(found.front());
    QTest::mouseClick(list->viewport(), Qt::LeftButton, {},
                      list->visualRect(found.front()).center());
    ASSERT_TRUE(list->selectionModel()->isSelected(found.front())) << text.toStdString();
}

// Empties a text field (a combo box's own line) with End and Backspace, then types `latin1`
// key by key. QTest's own typing knows only ASCII keys, so every letter is sent as its key
// carrying its text, as a keyboard sends them.
inline void retype(QWidget* field, const char* latin1) {
    auto* line = qobject_cast<QLineEdit*>(field);
    if (line == nullptr) line = static_cast<QComboBox*>(field)->lineEdit();
    line->setFocus();
    QTest::keyClick(line, Qt::Key_End);
    for (qsizetype n = line->text().size(); n > 0; --n) QTest::keyClick(line, Qt::Key_Backspace);
    for (QChar c : QString::fromLatin1(latin1)) {
        const auto key = static_cast<Qt::Key>(c.toUpper().unicode());
        QTest::sendKeyEvent(QTest::Press, line, key, QString(c), Qt::NoModifier);
        QTest::sendKeyEvent(QTest::Release, line, key, QString(c), Qt::NoModifier);
    }
}

}  // namespace qt_user
