#pragma once

#include <string>

#include "main_window/form1.h"

// Find as you type over the open list's titles in the main window. It only ever moves the
// selection of List1: no row is hidden, so the list, its count and every operation on it behave
// as they do without it.
namespace main_window {

class TitleFinder {
  public:
    explicit TitleFinder(Form1& form) : form_(form) {}

    // The "Find title" box now holds `text`: selects the first title that contains it (letter
    // case folded as the list sorts) and fills the entry fields as a click would. Without a
    // match it beeps and leaves the selection; an empty text does nothing.
    void Text_find_Change(const std::string& text);
    // Enter or F3: the next title after the selected one that contains the text, wrapping
    // around; Shift+F3 the previous one. Beeps when no title contains it.
    void FindNext() { step(1); }
    void FindPrevious() { step(-1); }

  private:
    void step(int direction);
    // Selects the first matching title from `start` on in `direction`, wrapping around.
    bool selectFrom(int start, int direction);

    Form1& form_;
    std::string needle_;  // folded
};

}  // namespace main_window
