#pragma once

#include <string>

// Services the windows use besides their controls.
namespace ui {

enum class Answer { Ok, Yes, No };

// What a message-box style asks for: the sum of a button set, an icon and a default button.
struct MessageStyle {
    enum class Buttons { Ok, YesNo } buttons = Buttons::Ok;
    enum class Icon { None, Critical, Question, Exclamation, Information } icon = Icon::None;
    bool secondIsDefault = false;  // "No" is the default button
};

// Message-box style numbers; a style is a button set plus an icon plus a default button.
inline constexpr int kOkOnly = 0;
inline constexpr int kYesNo = 4;
inline constexpr int kCritical = 16;
inline constexpr int kQuestion = 32;
inline constexpr int kExclamation = 48;
inline constexpr int kInformation = 64;
inline constexpr int kSecondDefault = 256;  // "No" rather than "Yes" is the default

// Reads a style number into its parts.
MessageStyle decodeStyle(int style);

class Platform {
  public:
    virtual ~Platform() = default;
    // Shows a message box and waits for the answer (Ok for the OK-only styles).
    virtual Answer messageBox(const std::string& prompt, int style, const std::string& title) = 0;
    virtual void beep() = 0;
    // Today's date in the system's short numeric form.
    virtual std::string shortDate() = 0;
    // The busy pointer; calls nest. Use BusyPointer rather than these.
    virtual void beginBusy() = 0;
    virtual void endBusy() = 0;
    // Ends the program at once with `status`; no window's unload handler runs.
    virtual void endProgram(int status) = 0;
};

// Shows the busy pointer for its lifetime, whatever way the scope is left.
class BusyPointer {
  public:
    explicit BusyPointer(Platform& platform) : platform_(platform) { platform_.beginBusy(); }
    ~BusyPointer() { platform_.endBusy(); }
    BusyPointer(const BusyPointer&) = delete;
    BusyPointer& operator=(const BusyPointer&) = delete;

  private:
    Platform& platform_;
};

}  // namespace ui
