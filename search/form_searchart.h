#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "catalogue/store.h"
#include "main_window/main_window_link.h"
#include "ui/controls.h"
#include "ui/platform.h"

// The dialog that finds the title carrying an article number in the selected list.
namespace search {

struct Form_searchartControls {
    ui::Window& window;          // the dialog
    ui::TextBox& Text1;          // article number to find
    ui::Label& Label1;           // hint
    ui::Button& Command_search;  // Search
    ui::Button& Command_cancel;  // Cancel
    ui::TextBox& Text2;          // title found
};

inline constexpr const char* kSearchCaption = "Search article number";
inline constexpr const char* kSearchHint = "Enter article number and click search.";
inline constexpr const char* kNotFound = "Can't found that article number!";

// What a search of `articleText` (a CR LF, then the article file's text) for `number` shows:
// the start of the line holding the first occurrence, ignoring case, up to four characters before
// it; for a whole article number that is its title. Empty when the occurrence begins within the
// first four characters of its line. Nothing when `number` is empty or does not occur.
std::optional<std::string> titleBefore(std::string_view articleText, std::string_view number);

class Form_searchart : public main_window::MainWindowDialog {
  public:
    // Sets the captions and the number limit and wires the dialog's events to its handlers.
    Form_searchart(const Form_searchartControls& controls, ui::Platform& platform,
                   catalogue::Store& store, main_window::MainWindowLink& main);

    // Opening: the selected list's article file is read once. When it cannot be read, a message
    // names the file and the dialog closes again.
    void Form_Load() override;
    // Every closing forgets the article text.
    void Form_Unload() override;

    // "Search": shows the title found in Text2, or a message leaving Text2 as it was.
    void Command_search_Click();
    // "Cancel": closes the dialog.
    void Command_cancel_Click();

    // The article text read when the dialog opened: CR LF, then each line followed by CR LF.
    std::string ArticleText;

  private:
    Form_searchartControls c_;
    ui::Platform& platform_;
    catalogue::Store& store_;
};

}  // namespace search
