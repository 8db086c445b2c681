// The article-number search dialog on the memory controls, over a real catalogue folder (a
// missing article file is the Qt dialogs test's).
#include "search/form_searchart.h"

#include <gtest/gtest.h>

#include <memory>
#include <optional>

#include "tests/support/memory_form1.h"

namespace {

using namespace ui::memory;

const std::string kNotFound = "Can't found that article number!";

// The main window with the search dialog on memory controls and a list "Rock" of three titles.
struct SearchDialog {
    SearchDialog() {
        own(window, Text1, Command_search, Command_cancel, Text2);
        dialog = std::make_unique<search::Form_searchart>(
            search::Form_searchartControls{window, Text1, Label1, Command_search, Command_cancel,
                                           Text2},
            f.platform, f.store, *f.form);
        f.form->setDialogs({nullptr, nullptr, &window});
        f.folder.put("pemla.dat", "Rock\r\n");
        f.folder.putList("Rock",
                         "<|?Abba Gold\r\n<|'CD\r\n<||1\r\n<|*Original\r\n"
                         "<|?Beatles 1\r\n<|'CD\r\n<||1\r\n<|*Original\r\n"
                         "<|?Abbey Road\r\n<|'CD\r\n<||2\r\n<|*Copy\r\n",
                         "Abba Gold#*\\A001\r\nBeatles 1#*\\B001\r\n\r\nAbbey Road#*\\A002\r\n",
                         "A#003\r\nB#002\r\n");
        f.start();
    }

    // Types a number afresh and presses "Search".
    void search(const std::string& number) {
        Text1.setText("");
        Text1.type(number);
        ASSERT_TRUE(Command_search.click());
    }

    test_support::MainWindowFixture f;
    MemoryWindow window;
    MemoryTextBox Text1;
    MemoryLabel Label1;
    MemoryButton Command_search;
    MemoryButton Command_cancel;
    MemoryTextBox Text2;
    std::unique_ptr<search::Form_searchart> dialog;
};

// Searches one after another in one opening, while the file changes on disk: the text read at
// opening is searched, and a number not found leaves the title shown before.
TEST(SearchDialog, OpensOverADisabledMainWindowAndSearchesTheTextReadAtOpening) {
    SearchDialog d;
    d.f.open("Rock");
    ASSERT_TRUE(d.f.view.Command_search.click());
    EXPECT_EQ(d.window.caption() + "|" + d.Label1.caption() + "|" + d.Command_search.caption() +
                  "|" + d.Command_cancel.caption(),
              "Search article number|Enter article number and click search.|Search|Cancel");
    EXPECT_TRUE(d.Text1.hasFocus());
    EXPECT_FALSE(d.f.view.window.isEnabled());
    EXPECT_EQ(d.dialog->ArticleText,
              "\r\nAbba Gold#*\\A001\r\nBeatles 1#*\\B001\r\n\r\nAbbey Road#*\\A002\r\n");
    d.f.folder.put("Rock.art", "Zappa#*\\Z001\r\n");
    const std::optional<std::string> kNone;  // not found
    // At the first to fourth character of its line nothing stands before a match; at the n-th,
    // n above four, the first n - 4 characters. Three digits: the first line holding them.
    // clang-format off
    const std::pair<std::string, std::optional<std::string>> steps[] = {
        {"a002", "Abbey Road"}, {"B001", "Beatles 1"}, {"001", "Abba Gold#"},
        {"Z001", kNone}, {"A003", kNone}, {"", kNone},
        {"abba", ""}, {"bba ", ""}, {"ba G", ""}, {"a Go", ""}, {"Gold", "Ab"}, {"y Ro", "A"},
    };
    // clang-format on
    d.Text2.setText("old");
    std::string shown = "old";
    std::size_t boxes = 0;
    for (const auto& [number, title] : steps) {
        SCOPED_TRACE("number \"" + number + "\"");
        if (!title) d.f.platform.answer(ui::Answer::Ok);
        d.search(number);
        shown = title.value_or(shown);
        EXPECT_EQ(d.Text2.text(), shown);
        if (!title) d.f.expectBox(boxes++, 16, "Error", kNotFound);
        EXPECT_TRUE(d.window.isLoaded());
    }
    EXPECT_EQ(d.f.form->selectedList(), "Rock");  // the search never touches the main window

    // Opened again, it starts with empty fields and reads the file anew.
    ASSERT_TRUE(d.Command_cancel.click());  // the rest of closing is every dialog's
    EXPECT_FALSE(d.window.isLoaded());
    ASSERT_TRUE(d.f.view.Command_search.click());
    EXPECT_EQ(d.Text1.text() + d.Text2.text(), "");
    d.search("z001");
    EXPECT_EQ(d.Text2.text(), "Zappa");
}

}  // namespace
