// The article-number search dialog on the memory controls, over a real catalogue folder.
#include "search/form_searchart.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <memory>

#include "new_list/form_new_list.h"
#include "tests/support/memory_form1.h"
#include "ui/memory/memory_controls.h"

namespace {

using test_support::MainWindowFixture;
using ui::Answer;
using namespace ui::memory;

const std::string kNotFound = "Can't found that article number!";

// The main window with the search dialog on memory controls, and a list "Rock" of three titles.
struct SearchDialog {
    SearchDialog() {
        for (Owned* control :
             std::initializer_list<Owned*>{&Text1, &Command_search, &Command_cancel, &Text2}) {
            control->setOwner(&window);
        }
        dialog = std::make_unique<search::Form_searchart>(
            search::Form_searchartControls{window, Text1, Label1, Command_search, Command_cancel,
                                           Text2},
            f.platform, f.store, *f.form);
        f.form->setDialogs({nullptr, nullptr, &window});
        f.folder.put("pemla.dat", "Pop\r\nRock\r\n");
        f.putList("Pop", "", "");
        f.putList("Rock",
                  "<|?Abba Gold\r\n<|'CD\r\n<||1\r\n<|*Original\r\n"
                  "<|?Beatles 1\r\n<|'CD\r\n<||1\r\n<|*Original\r\n"
                  "<|?Abbey Road\r\n<|'CD\r\n<||2\r\n<|*Copy\r\n",
                  "Abba Gold#*\\A001\r\nBeatles 1#*\\B001\r\n\r\nAbbey Road#*\\A002\r\n",
                  "A#003\r\nB#002\r\n");
    }

    // Opens the dialog on `list` from the main window.
    void openOn(const std::string& list) {
        f.start();
        f.open(list);
        ASSERT_TRUE(f.view.Command_search.click());
    }

    // Types a number afresh and presses "Search".
    void search(const std::string& number) {
        Text1.setText("");
        Text1.type(number);
        ASSERT_TRUE(Command_search.click());
    }

    MainWindowFixture f;
    MemoryWindow window;
    MemoryTextBox Text1;
    MemoryLabel Label1;
    MemoryButton Command_search;
    MemoryButton Command_cancel;
    MemoryTextBox Text2;
    std::unique_ptr<search::Form_searchart> dialog;
};

TEST(SearchDialog, OpensOverADisabledMainWindowWithTheArticleTextReadOnce) {
    SearchDialog d;
    d.openOn("Rock");
    EXPECT_TRUE(d.window.isLoaded());
    EXPECT_EQ(d.window.caption(), "Search article number");
    EXPECT_EQ(d.Label1.caption(), "Enter article number and click search.");
    EXPECT_EQ(d.Command_search.caption(), "Search");
    EXPECT_EQ(d.Command_cancel.caption(), "Cancel");
    EXPECT_TRUE(d.Text1.hasFocus());
    EXPECT_FALSE(d.f.view.window.isEnabled());
    EXPECT_EQ(d.dialog->ArticleText,
              "\r\nAbba Gold#*\\A001\r\nBeatles 1#*\\B001\r\n\r\nAbbey Road#*\\A002\r\n");
    d.Text1.type("A0021");
    EXPECT_EQ(d.Text1.text(), "A002");

    const int fronted = d.f.view.window.frontCount();
    ASSERT_TRUE(d.Command_cancel.click());
    EXPECT_FALSE(d.window.isLoaded());
    EXPECT_TRUE(d.f.view.window.isEnabled());
    EXPECT_GT(d.f.view.window.frontCount(), fronted);

    // Reopened on another list: fresh fields, that list's text; the close box also ends it.
    d.f.open("Pop");
    ASSERT_TRUE(d.f.view.Command_search.click());
    EXPECT_EQ(d.Text1.text(), "");
    EXPECT_EQ(d.dialog->ArticleText, "\r\n");
    d.window.userClose();
    EXPECT_FALSE(d.window.isLoaded());
    EXPECT_TRUE(d.f.view.window.isEnabled());
}

TEST(SearchDialog, FindsTheTitleOfANumberIgnoringCaseAndRepeatedly) {
    SearchDialog d;
    d.openOn("Rock");
    d.search("a002");
    EXPECT_EQ(d.Text2.text(), "Abbey Road");
    d.search("B001");
    EXPECT_EQ(d.Text2.text(), "Beatles 1");
    // Three digits match the first line holding them, one character before the number.
    d.search("001");
    EXPECT_EQ(d.Text2.text(), "Abba Gold#");
    EXPECT_TRUE(d.f.platform.shown().empty());
    // The search never touches the main window's choice.
    EXPECT_EQ(d.f.form->selectedList(), "Rock");
}

TEST(SearchDialog, NumberNotFoundOrEmptyLeavesTheTitleShown) {
    SearchDialog d;
    d.openOn("Rock");
    d.search("A001");
    ASSERT_EQ(d.Text2.text(), "Abba Gold");
    for (const std::string number : {"Z001", "A003", ""}) {
        SCOPED_TRACE("number \"" + number + "\"");
        d.f.platform.answer(Answer::Ok);
        d.search(number);
        ASSERT_FALSE(d.f.platform.shown().empty());
        EXPECT_EQ(d.f.platform.shown().back().prompt, kNotFound);
        EXPECT_EQ(d.f.platform.shown().back().title, "Error");
        EXPECT_EQ(d.f.platform.shown().back().style, 16);
        EXPECT_EQ(d.Text2.text(), "Abba Gold");
        EXPECT_TRUE(d.window.isLoaded());
    }
}

TEST(SearchDialog, TextFoundEarlyInItsLineShowsOnlyWhatStandsBeforeIt) {
    SearchDialog d;
    d.openOn("Rock");
    d.Text2.setText("old");
    // At the first to fourth character of the line: nothing stands before it.
    for (const std::string text : {"abba", "bba ", "ba G", "a Go"}) {
        d.search(text);
        EXPECT_EQ(d.Text2.text(), "") << text;
    }
    // At the n-th character, n above four: the first n - 4 characters.
    d.search("Gold");
    EXPECT_EQ(d.Text2.text(), "Ab");
    d.search("y Ro");
    EXPECT_EQ(d.Text2.text(), "A");
    EXPECT_TRUE(d.f.platform.shown().empty());
}

TEST(SearchDialog, KeepsSearchingTheTextReadWhenItOpened) {
    SearchDialog d;
    d.openOn("Rock");
    d.f.folder.put("Rock.art", "Zappa#*\\Z001\r\n");
    d.search("A002");
    EXPECT_EQ(d.Text2.text(), "Abbey Road");
    d.f.platform.answer(Answer::Ok);
    d.search("Z001");
    EXPECT_EQ(d.f.platform.shown().back().prompt, kNotFound);

    // Opened again, it reads the file anew.
    d.window.userClose();
    ASSERT_TRUE(d.f.view.Command_search.click());
    d.search("z001");
    EXPECT_EQ(d.Text2.text(), "Zappa");
}

TEST(SearchDialog, AMissingArticleFileIsNamedAndTheDialogCloses) {
    SearchDialog d;
    std::filesystem::remove(d.f.folder.file("Rock.art"));
    d.f.platform.answer(Answer::Ok);
    d.openOn("Rock");
    ASSERT_EQ(d.f.platform.shown().size(), 1u);
    EXPECT_NE(d.f.platform.shown()[0].prompt.find("\"Rock.art\""), std::string::npos);
    EXPECT_EQ(d.f.platform.shown()[0].title, "Error");
    EXPECT_EQ(d.f.platform.shown()[0].style, 16);
    EXPECT_FALSE(d.window.isLoaded());
    EXPECT_TRUE(d.f.view.window.isEnabled());
    EXPECT_EQ(d.dialog->ArticleText, "");
    // The main window is usable: the search opens again once the file is back.
    d.f.folder.put("Rock.art", "Abba Gold#*\\A001\r\n");
    ASSERT_TRUE(d.f.view.Command_search.click());
    EXPECT_TRUE(d.window.isLoaded());
}

// A list made by the new-list dialog holds the placeholder, found under "A001".
TEST(SearchDialog, FindsThePlaceholderOfANewList) {
    SearchDialog d;
    MemoryWindow newWindow;
    MemoryLabel label;
    MemoryTextBox name;
    MemoryCheckBox info;
    MemoryButton create;
    MemoryButton cancel;
    new_list::Form_new_list newList({newWindow, label, name, info, create, cancel}, d.f.platform,
                                    d.f.store, *d.f.form);
    d.f.form->setDialogs({&newWindow, nullptr, &d.window});
    d.f.start();
    ASSERT_TRUE(d.f.view.Command_create.click());
    name.type("Jazz");
    ASSERT_TRUE(create.click());

    d.f.open("Jazz");
    ASSERT_TRUE(d.f.view.Command_search.click());
    d.search("a001");
    EXPECT_EQ(d.Text2.text(), "Add an item and delete me!");
}

TEST(TitleBefore, StaysInsideTheTextWhereverTheMatchFalls) {
    const std::string text = "\r\nAB#*\\A001\r\n";
    EXPECT_EQ(search::titleBefore(text, "a001"), "AB");
    // A match that takes in the leading line break has no line before it.
    EXPECT_EQ(search::titleBefore(text, "\r\nAB"), "");
    EXPECT_EQ(search::titleBefore(text, "\nAB#"), "");
    EXPECT_EQ(search::titleBefore(text, "1\r\n"), "AB#*\\");
    EXPECT_EQ(search::titleBefore(text, ""), std::nullopt);
    EXPECT_EQ(search::titleBefore("", "A001"), std::nullopt);
    // A text without any line break: the line starts at the first character.
    EXPECT_EQ(search::titleBefore("XY#*\\B002", "b002"), "XY");
}

}  // namespace
