#pragma once

#include <functional>
#include <string>
#include <string_view>
#include <vector>

#include "list_order/list_order.h"

// The window controls the program's windows are written against. Text is ISO-8859-1 bytes, the
// same bytes the files hold, so every length counts characters. Two backends implement these:
// in-memory ones for tests (tests/support/memory) and ui/qt for the real program; one contract
// test suite holds them alike.
namespace ui {

using Handler = std::function<void()>;
// A key-press handler may set the character code to 0 to discard the key (8 is backspace).
using KeyHandler = std::function<void(int& key)>;

class Window {
  public:
    virtual ~Window() = default;
    // Shows the window without waiting. The first show runs onLoad first; showing a visible
    // window brings it to the front.
    virtual void show() = 0;
    // Closes the window; onUnload runs on every closing of a loaded window.
    virtual void unload() = 0;
    virtual bool isLoaded() const = 0;
    virtual void setEnabled(bool enabled) = 0;
    virtual bool isEnabled() const = 0;
    virtual void bringToFront() = 0;
    virtual void setCaption(const std::string& caption) = 0;

    Handler onLoad;
    Handler onUnload;
};

class Button {
  public:
    virtual ~Button() = default;
    virtual void setCaption(const std::string& caption) = 0;
    virtual void setEnabled(bool enabled) = 0;
    Handler onClick;
};

class Label {
  public:
    virtual ~Label() = default;
    virtual void setCaption(const std::string& caption) = 0;
    virtual std::string caption() const = 0;
};

// Items are kept in one fixed order: case-insensitive, ties by byte value. One item at most is
// selected. onClick fires when the user changes the selection, never when code does.
class ListBox {
  public:
    virtual ~ListBox() = default;
    // Puts one item at its place in the order, as a refill would; a selected item stays so.
    virtual void addItem(const std::string& text) = 0;
    // Takes out one item equal to `text`, as a refill without it would leave the others; false
    // when there is none. Removing the selected item leaves nothing selected.
    virtual bool removeItem(const std::string& text) = 0;
    // Replaces every item in one go; the way to fill a long list.
    virtual void setItems(list_order::Items items) = 0;
    virtual void clear() = 0;
    virtual int count() const = 0;
    // The item's text, as the box holds it until it changes.
    virtual std::string_view itemText(int index) const = 0;
    // The selected item's index, or -1 when none is selected.
    virtual int selectedIndex() const = 0;
    virtual bool selected(int index) const = 0;
    virtual void setSelected(int index, bool selected) = 0;
    virtual void refresh() = 0;

    Handler onClick;
};

// An editable combo box holds any text; a pick-only one only one of its items.
class ComboBox {
  public:
    virtual ~ComboBox() = default;
    virtual void addItem(const std::string& text) = 0;
    virtual void setItems(std::vector<std::string> items) = 0;
    virtual int itemCount() const = 0;
    virtual std::string itemText(int index) const = 0;
    virtual std::string text() const = 0;
    // Assignment by code: neither the key handler nor any limit applies. A pick-only box takes
    // only one of its items and returns false for any other text.
    virtual bool setText(const std::string& text) = 0;
    // How many characters of the text the user has selected: a typed key replaces them.
    virtual std::size_t selectedLength() const = 0;
    virtual void setEnabled(bool enabled) = 0;
    virtual bool isEnabled() const = 0;

    KeyHandler onKeyPress;
};

// Typing beyond the maximum length is refused; text set by code is kept whole.
class TextBox {
  public:
    virtual ~TextBox() = default;
    virtual std::string text() const = 0;
    virtual void setText(const std::string& text) = 0;
    virtual int maxLength() const = 0;
    // 0 means no limit.
    virtual void setMaxLength(int length) = 0;
    virtual void setFocus() = 0;
    virtual bool hasFocus() const = 0;
};

// 0 clear, 1 set, 2 greyed.
class CheckBox {
  public:
    virtual ~CheckBox() = default;
    virtual void setCaption(const std::string& caption) = 0;
    virtual int value() const = 0;
    virtual void setValue(int value) = 0;
};

// The volumes the output can go to. onChange fires whenever the drive changes, also by code.
class DriveList {
  public:
    virtual ~DriveList() = default;
    virtual std::vector<std::string> drives() const = 0;
    virtual std::string drive() const = 0;
    // False when the drive is not one of drives().
    virtual bool setDrive(const std::string& drive) = 0;
    Handler onChange;
};

// A folder chooser. Its path has no trailing separator except at a volume's root. Paths here, and
// the drives above, are the file system's own bytes, not Latin-1 text.
class DirList {
  public:
    virtual ~DirList() = default;
    virtual std::string path() const = 0;
    // False (path unchanged) when the folder cannot be read.
    virtual bool setPath(const std::string& path) = 0;
};

}  // namespace ui
