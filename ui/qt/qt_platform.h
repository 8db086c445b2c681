#pragma once

#include <functional>

#include "ui/platform.h"

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

}  // namespace ui::qt
