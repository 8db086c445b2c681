// One set of expectations for both control backends: what the window logic relies on holds for the
// in-memory controls of the fast tests and for the Qt widgets of the real program alike.
#include <gtest/gtest.h>

#include <QApplication>
#include <QClipboard>
#include <QComboBox>
#include <QDate>
#include <QKeyEvent>
#include <QLineEdit>
#include <QListWidget>
#include <QLocale>
#include <QMessageBox>
#include <QPushButton>
#include <QTest>
#include <deque>
#include <map>
#include <memory>
#include <tuple>

#include "ui/memory/memory_controls.h"
#include "ui/qt/qt_controls.h"
#include "ui/qt/qt_folders.h"
#include "ui/qt/qt_platform.h"

namespace {

using namespace ui;

// Types text the way a keyboard does, one key press per character, any character included;
// "\b" is the backspace key.
void typeText(QWidget* widget, const QString& text) {
    widget->setFocus();
    for (QChar c : text) {
        QKeyEvent press(QEvent::KeyPress,
                        c == '\b' ? int(Qt::Key_Backspace) : int(c.toUpper().unicode()),
                        Qt::NoModifier, QString(c));
        QApplication::sendEvent(widget, &press);
    }
}

struct MemoryBackend {
    memory::MemoryWindow window;
    std::deque<memory::MemoryListBox> lists;
    std::deque<memory::MemoryComboBox> combos;
    std::deque<memory::MemoryTextBox> texts;
    memory::MemoryDriveList driveList{{"/", "/tmp"}};

    auto& list() { return lists.emplace_back(); }
    auto& combo() { return combos.emplace_back(); }
    auto& text() { return texts.emplace_back(); }
    Window& win() { return window; }
    DriveList& drives() { return driveList; }
    std::string otherDrive() { return "/tmp"; }
    void select(memory::MemoryListBox& box, int index) { box.userSelect(index); }
    std::vector<std::string> displayed(memory::MemoryListBox& box) { return box.items(); }
    void type(auto& box, const std::string& keys) { box.type(keys); }
    void selectAll(memory::MemoryComboBox& box) { box.userSelectAll(); }
    void closeBox() { window.userClose(); }
};

struct QtBackend {
    QWidget top;
    std::deque<qt::QtListBox> lists;
    std::deque<qt::QtComboBox> combos;
    std::deque<qt::QtTextBox> texts;
    std::map<const void*, QWidget*> widgetOf;  // adapter -> the widget a user works with
    qt::QtWindow window{&top};
    qt::QtDriveList driveList{new QComboBox(&top)};

    // Keyed by the interface the tests hold, whose address may differ from the adapter's.
    template <class Face, class Adapter, class Widget>
    Face& add(std::deque<Adapter>& adapters, Widget* widget) {
        Face& face = adapters.emplace_back(widget);
        widgetOf[&face] = widget;
        return face;
    }
    ListBox& list() {
        auto* widget = new QListWidget(&top);
        widget->setGeometry(0, 0, 200, 300);
        return add<ListBox>(lists, widget);
    }
    ComboBox& combo() {
        auto* widget = new QComboBox(&top);
        widget->setEditable(true);
        return add<ComboBox>(combos, widget);
    }
    TextBox& text() { return add<TextBox>(texts, new QLineEdit(&top)); }
    Window& win() { return window; }
    DriveList& drives() { return driveList; }
    std::string otherDrive() {
        for (const auto& drive : driveList.drives()) {
            if (drive != driveList.drive()) return drive;
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
    void type(const auto& box, const std::string& keys) {
        typeText(widgetOf.at(&box), QString::fromLatin1(keys.data(), std::ssize(keys)));
    }
    void selectAll(ComboBox& box) {
        static_cast<QComboBox*>(widgetOf.at(&box))->lineEdit()->selectAll();
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

TYPED_TEST(ControlContract, ListBoxKeepsOneOrderAndOneSelectionAndClicksForTheUserOnly) {
    auto& list = this->b.list();
    int clicks = 0;
    list.onClick = [&] { ++clicks; };
    // What the window logic reads back, and the same as the user sees it.
    const auto items = [&] {
        std::vector<std::string> seen;
        for (int i = 0; i < list.count(); ++i) seen.push_back(list.itemText(i));
        EXPECT_EQ(this->b.displayed(list), seen);
        return seen;
    };
    list.setItems({"b", "abc", "ABD", "Abc", "\xE9t\xE9", "\xC9T\xC9", "z"});
    list.addItem("aB");
    EXPECT_EQ(items(), (std::vector<std::string>{"aB", "Abc", "abc", "ABD", "b", "z", "\xC9T\xC9",
                                                 "\xE9t\xE9"}));
    list.setSelected(2, true);
    list.setSelected(4, true);
    for (int i = 0; i < list.count(); ++i) EXPECT_EQ(list.selected(i), i == 4) << i;
    list.setSelected(4, false);

    // Filled again with one item more and one less, as after an add or a delete: same order,
    // nothing selected.
    list.setItems({"z", "b", "ABD", "Abc", "abc", "\xE9t\xE9", "aB", "new", "\xC9T\xC9"});
    list.setItems({"z", "b", "ABD", "Abc", "\xE9t\xE9", "aB", "new", "\xC9T\xC9", "c"});
    EXPECT_EQ(items(), (std::vector<std::string>{"aB", "Abc", "ABD", "b", "c", "new", "z",
                                                 "\xC9T\xC9", "\xE9t\xE9"}));
    for (int i = 0; i < list.count(); ++i) EXPECT_FALSE(list.selected(i)) << i;
    EXPECT_EQ(clicks, 0);
    this->b.select(list, 2);
    EXPECT_EQ(clicks, 1);
    this->b.select(list, 0);
    EXPECT_EQ(clicks, 2);
    for (int i = 0; i < list.count(); ++i) EXPECT_EQ(list.selected(i), i == 0) << i;
    list.clear();
    EXPECT_EQ(clicks, 2);
}

TYPED_TEST(ControlContract, TextBoxRefusesTypingBeyondItsLengthButKeepsAssignedText) {
    auto& box = this->b.text();
    box.setMaxLength(4);
    this->b.type(box, "abcdef");
    EXPECT_EQ(box.text(), "abcd");
    this->b.type(box, "\b\bxyz");
    EXPECT_EQ(box.text(), "abxy");
    for (const std::string assigned : {"a longer text by code", "\xC4\xD6\xDC\xDF"}) {
        box.setText(assigned);
        EXPECT_EQ(box.text(), assigned);
    }
}

TYPED_TEST(ControlContract, ComboBoxKeyHandlerCanDiscardKeys) {
    auto& box = this->b.combo();
    box.setItems({"first", "second"});
    std::vector<int> keys;
    box.onKeyPress = [&](int& key) {
        keys.push_back(key);
        if (key != 8 && box.text().size() - box.selectedLength() >= 3) key = 0;
    };
    box.setText("");
    this->b.type(box, "abcde");
    EXPECT_EQ(box.text(), "abc");
    this->b.type(box, "\bz");
    EXPECT_EQ(box.text(), "abz");
    EXPECT_EQ(keys, (std::vector<int>{'a', 'b', 'c', 'd', 'e', 8, 'z'}));
    this->b.selectAll(box);  // a key typed over the selection replaces it
    this->b.type(box, "q");
    EXPECT_EQ(box.text(), "q");
    box.setText("assigned by code, past any limit");
    EXPECT_EQ(box.text(), "assigned by code, past any limit");
    EXPECT_EQ(box.itemCount(), 2);
}

TYPED_TEST(ControlContract, WindowLoadsOnFirstShowAndUnloadsOnEveryClosing) {
    ui::Window& window = this->b.win();
    int loads = 0, unloads = 0;
    window.onLoad = [&] { ++loads; };
    window.onUnload = [&] { ++unloads; };
    window.show();
    window.show();
    EXPECT_TRUE(window.isLoaded());
    this->b.closeBox();
    EXPECT_FALSE(window.isLoaded());
    EXPECT_EQ(std::pair(loads, unloads), std::pair(1, 1));
    window.show();
    window.unload();
    window.unload();
    EXPECT_EQ(std::pair(loads, unloads), std::pair(2, 2));
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

TEST(QtShortDate, IsAsciiDigitsInTheLocalesOrderNeverAMonthNameOrOtherDigits) {
    const std::pair<const char*, const char*> cases[] = {
        {"C", "06/12/2026"},     {"en_US", "12/6/26"},    {"de_DE", "06.12.26"},
        {"ar_EG", "06/12/2026"}, {"fa_IR", "2026/12/06"}, {"bn_BD", "06/12/2026"},
        {"mr_IN", "06/12/2026"}, {"my_MM", "06-12-2026"}, {"ko_KR", "26. 12. 6."}};
    for (const auto& [name, shown] : cases) {
        EXPECT_EQ(qt::numericDate(QLocale(QString::fromLatin1(name)), QDate(2026, 12, 6)), shown)
            << name;
    }
    // The program's own date under the locale this runs in; ctest runs it under C and fa_IR too.
    const std::string today = qt::QtPlatform().shortDate();
    EXPECT_EQ(today.find_first_not_of("0123456789/.- "), std::string::npos) << today;
}

TEST(QtTextEntry, TextTheFilesCannotHoldIsRefusedWholeWithABeep) {
    QtBackend b;
    ui::TextBox& box = b.text();
    ui::ComboBox& combo = b.combo();
    combo.setText("");
    int beeps = 0;
    qt::setRefusalHook([&] { ++beeps; });
    auto* edit = static_cast<QLineEdit*>(b.widgetOf.at(&box));
    // a, euro, e-acute typed: the euro alone is refused, each time with a beep.
    typeText(edit, QString::fromUtf8("a\xE2\x82\xAC\xC3\xA9"));
    typeText(b.widgetOf.at(&combo), QString::fromUtf8("b\xE2\x82\xAC\xC3\xB1"));
    EXPECT_EQ(std::make_tuple(box.text(), combo.text(), beeps),
              std::make_tuple("a\xE9", "b\xF1", 2));
    // Pasted text holding a euro sign or a line break is refused whole; Latin-1 gets in.
    for (const char* pasted : {"x\xE2\x82\xACy", "two\r\nlines", "\xC3\xA4\xC3\x98\xC3\x9F"}) {
        QApplication::clipboard()->setText(QString::fromUtf8(pasted));
        edit->paste();
    }
    EXPECT_EQ(std::make_tuple(box.text(), beeps), std::make_tuple("a\xE9\xE4\xD8\xDF", 4));
    // A control character the program put there does not stop further typing.
    box.setText("tab\there");
    combo.setText("tab\there");
    typeText(edit, "!");
    typeText(b.widgetOf.at(&combo), "!");
    EXPECT_EQ(std::make_tuple(box.text(), combo.text(), beeps),
              std::make_tuple("tab\there!", "tab\there!", 4));
    qt::setRefusalHook(nullptr);
}

}  // namespace
