#include "tests/support/memory/memory_controls.h"

#include <algorithm>
#include <filesystem>
#include <stdexcept>
#include <utility>

#include "list_order/list_order.h"

namespace ui::memory {

void MemoryWindow::show() {
    if (loaded_) return bringToFront();
    loaded_ = true;
    if (onLoad) onLoad();
}

void MemoryWindow::unload() {
    if (!loaded_) return;
    loaded_ = false;  // an unload handler that closes the window again must not run twice
    if (onUnload) onUnload();
}

bool MemoryButton::click() {
    if (!acceptsInput()) return false;
    if (onClick) onClick();
    return true;
}

void MemoryListBox::addItem(const std::string& text) {
    const int index = static_cast<int>(items_.insert(text));
    if (selected_ >= index) ++selected_;
}

bool MemoryListBox::removeItem(const std::string& text) {
    const std::size_t at = items_.remove(text);
    if (at == list_order::Items::npos) return false;
    const int index = static_cast<int>(at);
    if (selected_ == index) selected_ = -1;
    if (selected_ > index) --selected_;
    return true;
}

void MemoryListBox::setItems(list_order::Items items) {
    items_ = std::move(items);
    selected_ = -1;
}

void MemoryListBox::setSelected(int index, bool selected) {
    if (index < 0 || index >= count()) throw std::out_of_range("list box index");
    if (selected || selected_ == index) selected_ = selected ? index : -1;
}

bool MemoryListBox::userSelect(int index) {
    if (!acceptsInput() || index < 0 || index >= count()) return false;
    if (selected_ == index) return true;
    selected_ = index;
    if (onClick) onClick();
    return true;
}

bool MemoryListBox::userSelect(const std::string& text) {
    for (int i = 0; i < count(); ++i) {
        if (itemText(i) == text) return userSelect(i);
    }
    return false;
}

bool MemoryComboBox::setText(const std::string& text) {
    if (pickOnly_ && std::find(items_.begin(), items_.end(), text) == items_.end()) return false;
    text_ = text;
    allSelected_ = false;
    return true;
}

void MemoryComboBox::type(const std::string& keys) {
    if (!acceptsInput() || pickOnly_) return;
    for (unsigned char c : keys) {
        int key = c;
        if (onKeyPress) onKeyPress(key);
        if (key == 0) continue;
        // A key typed over the selected text replaces it; a backspace only removes it.
        if (std::exchange(allSelected_, false)) {
            text_.clear();
        } else if (key == 8 && !text_.empty()) {
            text_.pop_back();
        }
        if (key != 8) text_.push_back(static_cast<char>(key));
    }
}

bool MemoryComboBox::userPick(int index) {
    if (!acceptsInput() || index < 0 || index >= itemCount()) return false;
    return setText(items_[static_cast<std::size_t>(index)]);
}

void MemoryTextBox::type(const std::string& keys) {
    if (!acceptsInput()) return;
    for (char c : keys) {
        const bool fits = maxLength_ <= 0 || static_cast<int>(text_.size()) < maxLength_;
        if (c == '\b' && !text_.empty()) text_.pop_back();
        if (c != '\b' && fits) text_.push_back(c);
    }
}

bool MemoryCheckBox::userToggle() {
    if (!acceptsInput()) return false;
    value_ = value_ == 1 ? 0 : 1;
    return true;
}

void MemoryDriveList::offer(std::vector<std::string> drives) {
    drives_ = std::move(drives);
    drive_ = drives_.empty() ? std::string() : drives_.front();
}

bool MemoryDriveList::setDrive(const std::string& drive) {
    if (std::find(drives_.begin(), drives_.end(), drive) == drives_.end()) return false;
    if (drive == drive_) return true;
    drive_ = drive;
    if (onChange) onChange();
    return true;
}

bool MemoryDirList::setPath(const std::string& path) {
    std::error_code ec;
    std::filesystem::directory_iterator probe(path, ec);
    if (ec) return false;
    path_ = path;
    while (path_.size() > 1 && path_.ends_with('/')) path_.pop_back();
    return true;
}

Answer MemoryPlatform::messageBox(const std::string& prompt, int style, const std::string& title) {
    shown_.push_back({prompt, title, style});
    // A box under the busy pointer looks as if the program were still working.
    if (busyDepth > 0) throw MessageBoxWhileBusy{shown_.back()};
    if (answers_.empty()) throw UnscriptedMessageBox{shown_.back()};
    const Answer next = answers_.front();
    answers_.pop_front();
    return next;
}

void MemoryPlatform::beginBusy() {
    ++busyDepth;
    ++busyCount;
}

}  // namespace ui::memory
