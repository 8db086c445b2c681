#include "ui/qt/qt_platform.h"

#include <QApplication>
#include <QDate>
#include <QLocale>
#include <QMessageBox>

#include "ui/qt/qt_controls.h"

namespace ui::qt {

namespace {

std::function<Answer(QMessageBox&)>& answerHook() {
    static std::function<Answer(QMessageBox&)> hook;
    return hook;
}

}  // namespace

void QtPlatform::setAnswerHook(std::function<Answer(QMessageBox&)> hook) {
    answerHook() = std::move(hook);
}

Answer QtPlatform::messageBox(const std::string& prompt, int style, const std::string& title) {
    const MessageStyle decoded = decodeStyle(style);
    QMessageBox box(QApplication::activeWindow());
    box.setWindowTitle(toQt(title));
    box.setTextFormat(Qt::PlainText);
    box.setText(toQt(prompt).replace(QStringLiteral("\r\n"), QStringLiteral("\n")));
    switch (decoded.icon) {
        case MessageStyle::Icon::Critical:
            box.setIcon(QMessageBox::Critical);
            break;
        case MessageStyle::Icon::Question:
            box.setIcon(QMessageBox::Question);
            break;
        case MessageStyle::Icon::Exclamation:
            box.setIcon(QMessageBox::Warning);
            break;
        case MessageStyle::Icon::Information:
            box.setIcon(QMessageBox::Information);
            break;
        case MessageStyle::Icon::None:
            box.setIcon(QMessageBox::NoIcon);
            break;
    }
    if (decoded.buttons == MessageStyle::Buttons::YesNo) {
        box.setStandardButtons(QMessageBox::Yes | QMessageBox::No);
        box.setDefaultButton(decoded.secondIsDefault ? QMessageBox::No : QMessageBox::Yes);
        box.setEscapeButton(QMessageBox::No);
    } else {
        box.setStandardButtons(QMessageBox::Ok);
        box.setDefaultButton(QMessageBox::Ok);
    }
    if (answerHook()) return answerHook()(box);
    const int pressed = box.exec();
    if (decoded.buttons == MessageStyle::Buttons::Ok) return Answer::Ok;
    return pressed == QMessageBox::Yes ? Answer::Yes : Answer::No;
}

void QtPlatform::beep() {
    QApplication::beep();
}

std::string QtPlatform::shortDate() {
    return fromQt(QLocale::system().toString(QDate::currentDate(), QLocale::ShortFormat));
}

void QtPlatform::beginBusy() {
    QApplication::setOverrideCursor(Qt::WaitCursor);
}

void QtPlatform::endBusy() {
    QApplication::restoreOverrideCursor();
}

void QtPlatform::endProgram(int status) {
    ended_ = true;
    status_ = status;
    QtWindow::setEnding(true);
    QApplication::exit(status);
}

}  // namespace ui::qt
