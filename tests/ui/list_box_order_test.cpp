// The Qt list box moved by one title equals a refill with the titles it then holds, in what the
// window reads and in the rows the user sees.
#include <gtest/gtest.h>

#include <QListWidget>

#include "ui/qt/qt_controls.h"

namespace {

using Strings = std::vector<std::string>;

Strings shown(ui::qt::QtListBox& box, QListWidget& widget) {
    Strings rows;
    for (int i = 0; i < box.count(); ++i) {
        rows.push_back(box.itemText(i));
        EXPECT_EQ(widget.item(i)->text().toLatin1().toStdString(), rows.back());
    }
    EXPECT_EQ(widget.count(), box.count());
    return rows;
}

TEST(QtListBoxOrder, OneTitleMovedEqualsARefill) {
    const Strings start = {"abc", "Abd", "m\xE9t\xE9", "1st", "zulu", "\xC9t\xE9"};
    struct Case {
        std::string removed, added;  // either may be empty
    };
    for (const Case& c : std::vector<Case>{{"", "0"},
                                           {"", "MMM"},
                                           {"", "\xFFz"},
                                           {"", "ABC"},
                                           {"", "\xE9T\xC9"},
                                           {"1st", "zzz"},
                                           {"zulu", "0"},
                                           {"abc", "ABC"},
                                           {"\xC9t\xE9", "\xE9t\xE9"},
                                           {"1st", ""},
                                           {"m\xE9t\xE9", ""},
                                           {"\xC9t\xE9", ""}}) {
        SCOPED_TRACE(c.removed + " -> " + c.added);
        QListWidget editedWidget, refilledWidget;
        ui::qt::QtListBox edited(&editedWidget), refilled(&refilledWidget);
        int clicks = 0;
        edited.onClick = [&] { ++clicks; };
        edited.setItems(start);
        Strings titles = start;
        if (!c.removed.empty()) {
            edited.setSelected(edited.count() - 1, true);
            EXPECT_TRUE(edited.removeItem(c.removed));
            std::erase(titles, c.removed);
        }
        if (!c.added.empty()) edited.addItem(c.added), titles.push_back(c.added);
        refilled.setItems(titles);
        EXPECT_EQ(shown(edited, editedWidget), shown(refilled, refilledWidget));
        EXPECT_FALSE(edited.removeItem("not there"));
        EXPECT_EQ(clicks, 0);
    }
}

}  // namespace
