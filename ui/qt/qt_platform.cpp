#include "ui/qt/qt_platform.h"

#include <QApplication>
#include <QDate>
#include <QLocale>
#include <QMessageBox>
#include <algorithm>
#include <utility>

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
    return numericDate(QLocale::system(), QDate::currentDate());
}

std::string numericDate(const QLocale& locale, const QDate& date) {
    const QString shown = locale.toString(date, QLocale::ShortFormat);
    bool digits = false;
    bool plain = true;
    for (const QChar c : shown) {
        if (c >= u'0' && c <= u'9') {
            digits = true;
        } else if (c.unicode() > 0x7E || c.isLetter() || c.isDigit() || c.unicode() < 0x20) {
            plain = false;
        }
    }
    if (plain && digits) return fromQt(shown);

    // The order of day, month and year in the format; quoted literals are skipped.
    const QString format = locale.dateFormat(QLocale::ShortFormat);
    qsizetype day = -1;
    qsizetype month = -1;
    qsizetype year = -1;
    for (qsizetype i = 0; i < format.size();) {
        const QChar c = format[i];
        if (c == u'\'') {
            const qsizetype close = format.indexOf(u'\'', i + 1);
            i = close < 0 ? format.size() : close + 1;
            continue;
        }
        qsizetype end = i;
        while (end < format.size() && format[end] == c) ++end;
        if (c == u'd' && end - i <= 2 && day < 0) day = i;  // "ddd" names the weekday
        if (c == u'M' && month < 0) month = i;
        if (c == u'y' && year < 0) year = i;
        i = end;
    }
    const QString yyyy = QString::number(date.year()).rightJustified(4, u'0');
    const QString mm = QString::number(date.month()).rightJustified(2, u'0');
    const QString dd = QString::number(date.day()).rightJustified(2, u'0');
    if (day < 0 || month < 0 || year < 0) return fromQt(yyyy + u'-' + mm + u'-' + dd);
    QChar separator = u'/';
    for (const QChar c : format) {
        if (c == u'/' || c == u'.' || c == u'-') {
            separator = c;
            break;
        }
    }
    std::pair<qsizetype, QString> parts[] = {{day, dd}, {month, mm}, {year, yyyy}};
    std::sort(std::begin(parts), std::end(parts),
              [](const auto& a, const auto& b) { return a.first < b.first; });
    return fromQt(parts[0].second + separator + parts[1].second + separator + parts[2].second);
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
