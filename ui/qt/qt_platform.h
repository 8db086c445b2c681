#pragma once

#include <functional>

#include "ui/platform.h"

class QDate;
class QLocale;
class QMessageBox;

namespace ui::qt {

// Message boxes, beep, date, busy pointer and ending the program on Qt.
class QtPlatform : public Platform {
  public:
    Answer messageBox(const std::string& prompt, int style, const std::string& title) override;
    void beep() override;
    std::string shortDate() override;
    void beginBusy() override;
    void endBusy() override;
    // Leaves the event loop with `status` and runs no unload handler any more. Before the loop
    // runs, ended() tells main() not to start it.
    void endProgram(int status) override;

    bool ended() const { return ended_; }
    int status() const { return status_; }

    // For tests: answers each message box instead of the user. The box is fully built (title,
    // text, icon, buttons, default button) when the hook sees it.
    static void setAnswerHook(std::function<Answer(QMessageBox&)> hook);

  private:
    bool ended_ = false;
    int status_ = 0;
};

// The date as the report prints it: the locale's short date when that is ASCII digits and marks;
// otherwise day, month and year as ASCII digits in the locale's order ("06/12/2026"), or
// "2026-12-06" when the locale's order cannot be told. Never a month name, never other digits.
std::string numericDate(const QLocale& locale, const QDate& date);

}  // namespace ui::qt
