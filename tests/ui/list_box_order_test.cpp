// The Qt list box moved by one title equals a refill with the titles it then holds, in what the
// window reads and in the rows the user sees.
#include <gtest/gtest.h>

#include <QListView>

#include "tests/e2e/qt_user.h"
#include "ui/qt/qt_controls.h"

namespace {

using Strings = std::vector<std::string>;

TEST(QtListBoxOrder, OneTitleMovedEqualsARefill) {
    const Strings start = {"abc", "Abd", "m\xE9t\xE9", "1st", "zulu", "\xC9t\xE9"};
    // Title taken out, title put in: adds, changes and deletes at the top, middle and bottom,
    // of a case-only twin and of accented titles.
    const std::vector<std::pair<std::string, std::string>> cases = {
        {"", "0"},     {"", "MMM"},        {"", "\xFFz"},
        {"", "ABC"},   {"", "\xE9T\xC9"},  {"1st", "zz"},
        {"zulu", "0"}, {"abc", "ABC"},     {"\xC9t\xE9", "\xE9t\xE9"},
        {"1st", ""},   {"m\xE9t\xE9", ""}, {"\xC9t\xE9", ""}};
    for (const auto& [removed, added] : cases) {
        SCOPED_TRACE(removed + " -> " + added);
        QListView editedRows, refilledRows;
        ui::qt::QtListBox edited(&editedRows), refilled(&refilledRows);
        edited.onClick = [] { ADD_FAILURE() << "a click for a change by code"; };
        edited.setItems(start);
        edited.setSelected(edited.count() - 1, true);
        Strings titles = start;
        if (!removed.empty()) {
            EXPECT_TRUE(edited.removeItem(removed));
            std::erase(titles, removed);
        }
        if (!added.empty()) edited.addItem(added), titles.push_back(added);
        EXPECT_FALSE(edited.removeItem("not there"));
        refilled.setItems(titles);
        ASSERT_EQ(qt_user::rows(&editedRows), refilled.count());
        for (int i = 0; i < refilled.count(); ++i) {
            EXPECT_EQ(edited.itemText(i), refilled.itemText(i));
            EXPECT_EQ(qt_user::rowText(&editedRows, i), qt_user::rowText(&refilledRows, i));
        }
    }
}

// A refill replaces the rows the view shows, and a user's pick is a click.
TEST(QtListBoxOrder, ARefillReplacesTheRowsAndTheUserStillClicks) {
    QListView rows;
    ui::qt::QtListBox box(&rows);
    int clicks = 0;
    box.onClick = [&] { ++clicks; };
    Strings many;
    for (char c = 'z'; c >= 'a'; --c) many.push_back(std::string(1, c));
    box.setItems(Strings{"only"});
    box.setItems(many);
    ASSERT_EQ(qt_user::rows(&rows), 26);
    EXPECT_EQ(qt_user::rowText(&rows, 25), "z");
    rows.selectionModel()->select(rows.model()->index(3, 0), QItemSelectionModel::ClearAndSelect);
    EXPECT_EQ(clicks, 1);
    EXPECT_EQ(box.selectedIndex(), 3);
    EXPECT_EQ(box.itemText(3), "d");
}

}  // namespace
