// One set of expectations for both control backends: what the window logic relies on holds for the
// in-memory controls of the fast tests and for the Qt widgets of the real program alike.
#include <gtest/gtest.h>

#include <QApplication>
#include <QCheckBox>
#include <QComboBox>
#include <QKeyEvent>
#include <QLineEdit>
#include <QListWidget>
#include <QMessageBox>
#include <QPushButton>
#include <QTest>
#include <map>
#include <memory>

#include "ui/memory/memory_controls.h"
#include "ui/qt/qt_controls.h"
#include "ui/qt/qt_folders.h"
#include "ui/qt/qt_platform.h"

namespace {

using namespace ui;

// Types text the way a keyboard does, one key event per character, any character included.
void typeText(QWidget* widget, const QString& text) {
    for (QChar c : text) {
        const int key = c.toUpper().unicode();
        QKeyEvent press(QEvent::KeyPress, key, Qt::NoModifier, QString(c));
        QApplication::sendEvent(widget, &press);
        QKeyEvent release(QEvent::KeyRelease, key, Qt::NoModifier, QString(c));
        QApplication::sendEvent(widget, &release);
    }
}

struct MemoryBackend {
    memory::MemoryWindow window;
    std::vector<std::unique_ptr<memory::MemoryListBox>> lists;
    std::vector<std::unique_ptr<memory::MemoryComboBox>> combos;
    std::vector<std::unique_ptr<memory::MemoryTextBox>> texts;
    memory::MemoryDriveList driveList{{"/", "/tmp"}};

    ListBox& list() { return *lists.emplace_back(std::make_unique<memory::MemoryListBox>()); }
    ComboBox& combo() { return *combos.emplace_back(std::make_unique<memory::MemoryComboBox>()); }
    TextBox& text() { return *texts.emplace_back(std::make_unique<memory::MemoryTextBox>()); }
    Window& win() { return window; }
    DriveList& drives() { return driveList; }
    std::string otherDrive() { return "/tmp"; }

    void select(ListBox& box, int index) {
        static_cast<memory::MemoryListBox&>(box).userSelect(index);
    }
    std::vector<std::string> displayed(ListBox& box) {
        return static_cast<memory::MemoryListBox&>(box).items();
    }
    void type(ComboBox& box, const std::string& keys) {
        static_cast<memory::MemoryComboBox&>(box).type(keys);
    }
    void type(TextBox& box, const std::string& keys) {
        static_cast<memory::MemoryTextBox&>(box).type(keys);
    }
    void closeBox() { window.userClose(); }
};

struct QtBackend {
    QWidget top;
    std::vector<std::unique_ptr<ListBox>> lists;
    std::vector<std::unique_ptr<ComboBox>> combos;
    std::vector<std::unique_ptr<TextBox>> texts;
    std::map<const void*, QWidget*> widgetOf;  // adapter -> the widget a user works with
    std::unique_ptr<qt::QtWindow> window;
    std::unique_ptr<qt::QtDriveList> driveList;

    ListBox& list() {
        auto* widget = new QListWidget(&top);
        widget->setGeometry(0, 0, 200, 300);
        auto& adapter = *lists.emplace_back(std::make_unique<qt::QtListBox>(widget));
        widgetOf[&adapter] = widget;
        return adapter;
    }
    ComboBox& combo() {
        auto* widget = new QComboBox(&top);
        widget->setEditable(true);
        auto& adapter = *combos.emplace_back(std::make_unique<qt::QtComboBox>(widget));
        widgetOf[&adapter] = widget;
        return adapter;
    }
    TextBox& text() {
        auto* widget = new QLineEdit(&top);
        auto& adapter = *texts.emplace_back(std::make_unique<qt::QtTextBox>(widget));
        widgetOf[&adapter] = widget;
        return adapter;
    }
    Window& win() {
        if (!window) window = std::make_unique<qt::QtWindow>(&top);
        return *window;
    }
    DriveList& drives() {
        driveList = std::make_unique<qt::QtDriveList>(new QComboBox(&top));
        return *driveList;
    }
    std::string otherDrive() {
        for (const auto& drive : driveList->drives()) {
            if (drive != driveList->drive()) return drive;
        }
        return {};
    }

    std::vector<std::string> displayed(ListBox& box) {
        auto* widget = static_cast<QListWidget*>(widgetOf.at(&box));
        std::vector<std::string> texts;
        for (int i = 0; i < widget->count(); ++i)
            texts.push_back(qt::fromQt(widget->item(i)->text()));
        return texts;
    }
    void select(ListBox& box, int index) {
        auto* widget = static_cast<QListWidget*>(widgetOf.at(&box));
        const QRect where = widget->visualItemRect(widget->item(index));
        QTest::mouseClick(widget->viewport(), Qt::LeftButton, {}, where.center());
    }
    void type(ComboBox& box, const std::string& keys) { typeInto(widgetOf.at(&box), keys); }
    void type(TextBox& box, const std::string& keys) { typeInto(widgetOf.at(&box), keys); }
    static void typeInto(QWidget* widget, const std::string& keys) {
        widget->setFocus();
        for (unsigned char c : keys) {
            if (c == '\b') {
                QTest::keyClick(widget, Qt::Key_Backspace);
            } else {
                typeText(widget, QString(QChar(c)));
            }
        }
    }
    void closeBox() { top.close(); }
};

template <class Backend>
class ControlContract : public ::testing::Test {
  protected:
    Backend b;
};

using Backends = ::testing::Types<MemoryBackend, QtBackend>;
TYPED_TEST_SUITE(ControlContract, Backends);

TYPED_TEST(ControlContract, ListBoxKeepsOneOrderAndOneSelection) {
    ui::ListBox& list = this->b.list();
    list.setItems({"b", "abc", "ABD", "Abc", "\xE9t\xE9", "\xC9T\xC9", "z"});
    list.addItem("aB");
    std::vector<std::string> seen;
    for (int i = 0; i < list.count(); ++i) seen.push_back(list.itemText(i));
    EXPECT_EQ(seen, (std::vector<std::string>{"aB", "Abc", "abc", "ABD", "b", "z", "\xC9T\xC9",
                                              "\xE9t\xE9"}));
    list.setSelected(2, true);
    list.setSelected(4, true);
    int selectedCount = 0;
    for (int i = 0; i < list.count(); ++i) selectedCount += list.selected(i) ? 1 : 0;
    EXPECT_EQ(selectedCount, 1);
    EXPECT_TRUE(list.selected(4));

    // Filled again with one item more and one less, as after an add or a delete: same order,
    // nothing selected.
    list.setItems({"z", "b", "ABD", "Abc", "abc", "\xE9t\xE9", "aB", "new", "\xC9T\xC9"});
    list.setItems({"z", "b", "ABD", "Abc", "\xE9t\xE9", "aB", "new", "\xC9T\xC9", "c"});
    seen.clear();
    for (int i = 0; i < list.count(); ++i) seen.push_back(list.itemText(i));
    const std::vector<std::string> expected{"aB",  "Abc", "ABD",       "b",        "c",
                                            "new", "z",   "\xC9T\xC9", "\xE9t\xE9"};
    EXPECT_EQ(seen, expected);
    EXPECT_EQ(this->b.displayed(list), expected);
    for (int i = 0; i < list.count(); ++i) EXPECT_FALSE(list.selected(i)) << i;
}

TYPED_TEST(ControlContract, ListBoxClickFiresForTheUserOnly) {
    ui::ListBox& list = this->b.list();
    int clicks = 0;
    list.onClick = [&] { ++clicks; };
    list.setItems({"one", "two", "three"});
    list.setSelected(1, true);
    list.setSelected(1, false);
    list.addItem("four");
    list.clear();
    EXPECT_EQ(clicks, 0);
    list.setItems({"one", "two", "three"});
    this->b.select(list, 2);
    EXPECT_EQ(clicks, 1);
    EXPECT_TRUE(list.selected(2));
    this->b.select(list, 0);
    EXPECT_EQ(clicks, 2);
}

TYPED_TEST(ControlContract, TextBoxRefusesTypingBeyondItsLengthButKeepsAssignedText) {
    ui::TextBox& box = this->b.text();
    box.setMaxLength(4);
    this->b.type(box, "abcdef");
    EXPECT_EQ(box.text(), "abcd");
    this->b.type(box, "\b\bxyz");
    EXPECT_EQ(box.text(), "abxy");
    box.setText("a longer text by code");
    EXPECT_EQ(box.text(), "a longer text by code");
    box.setText("\xC4\xD6\xDC\xDF");
    EXPECT_EQ(box.text(), "\xC4\xD6\xDC\xDF");
}

TYPED_TEST(ControlContract, ComboBoxKeyHandlerCanDiscardKeys) {
    ui::ComboBox& box = this->b.combo();
    box.setItems({"first", "second"});
    std::vector<int> keys;
    box.onKeyPress = [&](int& key) {
        keys.push_back(key);
        if (key != 8 && box.text().size() >= 3) key = 0;
    };
    box.setText("");
    this->b.type(box, "abcde");
    EXPECT_EQ(box.text(), "abc");
    this->b.type(box, "\bz");
    EXPECT_EQ(box.text(), "abz");
    EXPECT_EQ(keys, (std::vector<int>{'a', 'b', 'c', 'd', 'e', 8, 'z'}));
    box.setText("assigned by code, past any limit");
    EXPECT_EQ(box.text(), "assigned by code, past any limit");
    EXPECT_EQ(box.itemCount(), 2);
}

TYPED_TEST(ControlContract, WindowLoadsOnFirstShowAndUnloadsOnEveryClosing) {
    ui::Window& window = this->b.win();
    int loads = 0;
    int unloads = 0;
    window.onLoad = [&] { ++loads; };
    window.onUnload = [&] { ++unloads; };
    window.show();
    window.show();
    EXPECT_EQ(loads, 1);
    EXPECT_TRUE(window.isLoaded());
    this->b.closeBox();
    EXPECT_EQ(unloads, 1);
    EXPECT_FALSE(window.isLoaded());
    window.show();
    EXPECT_EQ(loads, 2);
    window.unload();
    EXPECT_EQ(unloads, 2);
    window.unload();
    EXPECT_EQ(unloads, 2);
}

TYPED_TEST(ControlContract, DriveChangeFiresForCodeToo) {
    ui::DriveList& drives = this->b.drives();
    const std::string other = this->b.otherDrive();
    if (other.empty()) GTEST_SKIP() << "only one mounted volume here";
    int changes = 0;
    drives.onChange = [&] { ++changes; };
    EXPECT_TRUE(drives.setDrive(other));
    EXPECT_EQ(drives.drive(), other);
    EXPECT_EQ(changes, 1);
    EXPECT_FALSE(drives.setDrive("no such volume"));
    EXPECT_EQ(drives.drive(), other);
}

TEST(MessageStyles, StylesMapToButtonsIconsAndDefaults) {
    struct Case {
        int style;
        QMessageBox::Icon icon;
        bool yesNo;
        QMessageBox::StandardButton defaultButton;
    };
    const Case cases[] = {
        {16, QMessageBox::Critical, false, QMessageBox::Ok},
        {64, QMessageBox::Information, false, QMessageBox::Ok},
        {4, QMessageBox::NoIcon, true, QMessageBox::Yes},
        {260, QMessageBox::NoIcon, true, QMessageBox::No},
        {308, QMessageBox::Warning, true, QMessageBox::No},
    };
    ui::qt::QtPlatform platform;
    for (const Case& c : cases) {
        bool seen = false;
        ui::qt::QtPlatform::setAnswerHook([&](QMessageBox& box) {
            seen = true;
            EXPECT_EQ(box.icon(), c.icon) << c.style;
            EXPECT_EQ(box.windowTitle(), QStringLiteral("T\xE9tel"));
            EXPECT_EQ(box.text(), QStringLiteral("line one\nline two"));
            const bool yesNo = box.button(QMessageBox::Yes) && box.button(QMessageBox::No) &&
                               !box.button(QMessageBox::Ok);
            EXPECT_EQ(yesNo, c.yesNo) << c.style;
            EXPECT_EQ(box.defaultButton(), box.button(c.defaultButton)) << c.style;
            return yesNo ? ui::Answer::No : ui::Answer::Ok;
        });
        const ui::Answer answer = platform.messageBox("line one\r\nline two", c.style, "T\xE9tel");
        EXPECT_TRUE(seen);
        EXPECT_EQ(answer, c.yesNo ? ui::Answer::No : ui::Answer::Ok);
    }
    ui::qt::QtPlatform::setAnswerHook(nullptr);
}

TEST(MemoryMessageBoxes, AnUnscriptedBoxFailsTheTest) {
    ui::memory::MemoryPlatform platform;
    EXPECT_THROW(platform.messageBox("surprise", 16, "Error"), ui::memory::UnscriptedMessageBox);
    platform.answer(ui::Answer::Yes);
    EXPECT_EQ(platform.messageBox("sure?", 4, "Change item"), ui::Answer::Yes);
    ASSERT_EQ(platform.shown().size(), 2u);
    EXPECT_EQ(platform.shown()[1].style, 4);
}

TEST(QtTextEntry, CharactersBeyondLatin1AreNeverTyped) {
    QWidget top;
    auto* edit = new QLineEdit(&top);
    ui::qt::QtTextBox box(edit);
    auto* comboWidget = new QComboBox(&top);
    comboWidget->setEditable(true);
    ui::qt::QtComboBox combo(comboWidget);
    combo.setText("");
    typeText(edit, QString::fromUtf8("a\xE2\x82\xAC\xC3\xA9"));  // a, euro sign, e-acute
    EXPECT_EQ(box.text(), "a\xE9");
    typeText(comboWidget, QString::fromUtf8("b\xE2\x82\xAC\xC3\xB1"));
    EXPECT_EQ(combo.text(), "b\xF1");
    // Pasted text goes through the same validator.
    edit->clear();
    edit->insert(QString::fromUtf8("x\xE2\x82\xAC"));
    EXPECT_EQ(box.text(), "");
}

}  // namespace
