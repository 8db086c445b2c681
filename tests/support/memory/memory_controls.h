#pragma once

#include <deque>
#include <optional>
#include <string>
#include <vector>

#include "ui/controls.h"
#include "ui/platform.h"

// In-memory controls for tests. Besides the control interface, each offers what a user does with
// it (click, type, select, close), and refuses it while the control or its window is disabled,
// just as a real window takes no input then.
namespace ui::memory {

// Base of the controls that sit on a window: input is refused while either is disabled.
class Owned {
  public:
    void setOwner(const Window* owner) { owner_ = owner; }
    bool acceptsInput() const { return ownEnabled_ && (owner_ == nullptr || owner_->isEnabled()); }

  protected:
    const Window* owner_ = nullptr;
    bool ownEnabled_ = true;
};

// Puts each control on `window`.
template <class... Controls>
void own(const Window& window, Controls&... controls) {
    (controls.setOwner(&window), ...);
}

// The state every kind of control keeps alike: its caption and whether it is enabled. Where the
// interface of `Base` declares these, they implement it.
template <class Base>
class Control : public Base, public Owned {
  public:
    void setCaption(const std::string& caption) { caption_ = caption; }
    std::string caption() const { return caption_; }
    void setEnabled(bool enabled) { ownEnabled_ = enabled; }
    bool isEnabled() const { return ownEnabled_; }

  private:
    std::string caption_;
};

class MemoryWindow : public Control<Window> {
  public:
    void show() override;
    void unload() override;
    bool isLoaded() const override { return loaded_; }
    void bringToFront() override { ++frontCount; }

    // The user closes the window with its close box.
    void userClose() { unload(); }
    int frontCount = 0;

  private:
    bool loaded_ = false;
};

class MemoryButton : public Control<Button> {
  public:
    // The user presses the button; false when it takes no input.
    bool click();
};

using MemoryLabel = Control<Label>;

class MemoryListBox : public Control<ListBox> {
  public:
    void addItem(const std::string& text) override;
    bool removeItem(const std::string& text) override;
    void setItems(list_order::Items items) override;
    void clear() override { setItems({}); }
    int count() const override { return static_cast<int>(items_.size()); }
    std::string_view itemText(int index) const override {
        return items_.at(static_cast<std::size_t>(index));
    }
    int selectedIndex() const override { return selected_; }
    bool selected(int index) const override { return index == selected_; }
    void setSelected(int index, bool selected) override;
    void refresh() override {}

    // The user selects an item; fires onClick when the selection changes.
    bool userSelect(int index);
    // The user selects the item with this text.
    bool userSelect(const std::string& text);
    std::vector<std::string> items() const { return items_.strings(); }

  private:
    list_order::Items items_;
    int selected_ = -1;
};

class MemoryComboBox : public Control<ComboBox> {
  public:
    explicit MemoryComboBox(bool pickOnly = false) : pickOnly_(pickOnly) {}
    void addItem(const std::string& text) override { items_.push_back(text); }
    void setItems(std::vector<std::string> items) override { items_ = std::move(items); }
    int itemCount() const override { return static_cast<int>(items_.size()); }
    std::string itemText(int index) const override { return items_.at(index); }
    std::string text() const override { return text_; }
    bool setText(const std::string& text) override;
    std::size_t selectedLength() const override { return allSelected_ ? text_.size() : 0; }

    // The user types these characters one by one, each through onKeyPress ('\b' deletes); the
    // first key that gets through replaces a selected text.
    void type(const std::string& keys);
    // The user selects the whole text.
    void userSelectAll() { allSelected_ = true; }
    // The user picks an item from the drop-down list.
    bool userPick(int index);

  private:
    bool pickOnly_;
    bool allSelected_ = false;
    std::vector<std::string> items_;
    std::string text_;
};

class MemoryTextBox : public Control<TextBox> {
  public:
    std::string text() const override { return text_; }
    void setText(const std::string& text) override { text_ = text; }
    int maxLength() const override { return maxLength_; }
    void setMaxLength(int length) override { maxLength_ = length; }
    void setFocus() override { focused_ = this; }
    bool hasFocus() const override { return focused_ == this; }

    // The user types these characters; those beyond the maximum length are refused.
    void type(const std::string& keys);

  private:
    static inline const TextBox* focused_ = nullptr;
    std::string text_;
    int maxLength_ = 0;
};

class MemoryCheckBox : public Control<CheckBox> {
  public:
    int value() const override { return value_; }
    void setValue(int value) override { value_ = value; }
    // The user clicks the box: set becomes clear, anything else set.
    bool userToggle();

  private:
    int value_ = 0;
};

class MemoryDriveList : public Control<DriveList> {
  public:
    explicit MemoryDriveList(std::vector<std::string> drives = {"/"}) { offer(std::move(drives)); }
    std::vector<std::string> drives() const override { return drives_; }
    std::string drive() const override { return drive_; }
    bool setDrive(const std::string& drive) override;
    // The volumes mounted from now on; the first is the current drive.
    void offer(std::vector<std::string> drives);

  private:
    std::vector<std::string> drives_;
    std::string drive_;
};

// Follows the real file system: a path is accepted when it names a readable folder.
class MemoryDirList : public Control<DirList> {
  public:
    std::string path() const override { return path_; }
    bool setPath(const std::string& path) override;

  private:
    std::string path_ = "/";
};

// A message box as shown. Thrown when shown under the busy pointer, or when the test did not
// script it: deliberately no std::exception, so that no handler guard can swallow it.
struct MessageBox {
    std::string prompt, title;
    int style;
};
struct MessageBoxWhileBusy : MessageBox {};
struct UnscriptedMessageBox : MessageBox {};

class MemoryPlatform : public Platform {
  public:
    using Shown = MessageBox;

    // Scripts the answer to the next message box.
    void answer(Answer next) { answers_.push_back(next); }
    Answer messageBox(const std::string& prompt, int style, const std::string& title) override;
    void beep() override { ++beeps; }
    std::string shortDate() override { return "06.12.2026"; }
    void beginBusy() override;
    void endBusy() override { --busyDepth; }
    void endProgram(int status) override { ended = status; }

    const std::vector<Shown>& shown() const { return shown_; }
    int beeps = 0;
    int busyDepth = 0;
    int busyCount = 0;
    std::optional<int> ended;  // the status the program ended with

  private:
    std::deque<Answer> answers_;
    std::vector<Shown> shown_;
};

}  // namespace ui::memory
