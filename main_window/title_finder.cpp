#include "main_window/title_finder.h"

#include "catalogue/latin1.h"

namespace main_window {

namespace {

void fold(std::string& text) {
    for (char& c : text) c = static_cast<char>(catalogue::foldByte(static_cast<unsigned char>(c)));
}

}  // namespace

void TitleFinder::Text_find_Change(const std::string& text) {
    needle_ = text;
    fold(needle_);
    if (needle_.empty()) return;
    if (!selectFrom(0, 1)) form_.platform().beep();
}

void TitleFinder::step(int direction) {
    if (needle_.empty()) return;
    const ui::ListBox& list = form_.controls().List1;
    const int current = list.selectedIndex();
    // Without a selection the search starts at the top (forwards) or the bottom (backwards).
    const int start = current < 0 ? (direction > 0 ? 0 : list.count() - 1) : current + direction;
    if (!selectFrom(start, direction)) form_.platform().beep();
}

bool TitleFinder::selectFrom(int start, int direction) {
    ui::ListBox& list = form_.controls().List1;
    const int count = list.count();
    std::string title;
    for (int n = 0; n < count; ++n) {
        const int i = ((start + n * direction) % count + count) % count;
        title = list.itemText(i);
        fold(title);
        if (title.find(needle_) == std::string::npos) continue;
        list.setSelected(i, true);
        form_.List1_Click();
        return true;
    }
    return false;
}

}  // namespace main_window
