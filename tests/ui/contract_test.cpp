// One set of expectations for both control backends: what the window logic relies on holds for the
// in-memory controls of the fast tests and for the Qt widgets of the real program alike.
#include <gtest/gtest.h>

#include <QApplication>
#include <QCheckBox>
#include <QClipboard>
#include <QComboBox>
#include <QDate>
#include <QKeyEvent>
#include <QLineEdit>
#include <QListView>
#include <QLocale>
#include <QMessageBox>
#include <QTest>
#include <QTimer>
#include <tuple>

#include "list_order/list_order.h"
#include "tests/e2e/qt_user.h"
#include "tests/support/memory/memory_controls.h"
#include "ui/qt/qt_controls.h"
#include "ui/qt/qt_folders.h"
#include "ui/qt/qt_platform.h"

namespace {

using namespace ui;
using Strings = std::vector<std::string>;

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

// One control of each kind, with what a user does to it.
struct MemoryBackend {
    memory::MemoryWindow window;
    memory::MemoryListBox list;
    memory::MemoryComboBox combo;
    memory::MemoryTextBox text;
    memory::MemoryDriveList drives{{"/", "/tmp"}};
    memory::MemoryCheckBox check;

    std::string otherDrive() { return "/tmp"; }
    void select(int index) { list.userSelect(index); }
    Strings displayed() { return list.items(); }
    void type(auto& box, const std::string& keys) { box.type(keys); }
    void selectAll() { combo.userSelectAll(); }
    void closeBox() { window.userClose(); }
};

struct QtBackend {
    QWidget top;
    QListView* listWidget = new QListView(&top);
    QComboBox* comboWidget = editable(new QComboBox(&top));
    QLineEdit* textWidget = new QLineEdit(&top);
    qt::QtWindow window{&top};
    qt::QtListBox list{listWidget};
    qt::QtComboBox combo{comboWidget};
    qt::QtTextBox text{textWidget};
    qt::QtDriveList drives{new QComboBox(&top)};
    qt::QtCheckBox check{new QCheckBox(&top)};

    QtBackend() { listWidget->setGeometry(0, 0, 200, 300); }
    static QComboBox* editable(QComboBox* box) {
        box->setEditable(true);
        return box;
    }
    std::string otherDrive() {
        for (const auto& drive : drives.drives()) {
            if (drive != drives.drive()) return drive;
        }
        return {};
    }
    void select(int index) {
        QTest::mouseClick(listWidget->viewport(), Qt::LeftButton, {},
                          listWidget->visualRect(listWidget->model()->index(index, 0)).center());
    }
    Strings displayed() {
        Strings texts;
        for (int i = 0; i < qt_user::rows(listWidget); ++i) {
            texts.push_back(qt::fromQt(qt_user::rowText(listWidget, i)));
        }
        return texts;
    }
    void type(const TextBox&, const std::string& keys) { typeText(textWidget, latin1(keys)); }
    void type(const ComboBox&, const std::string& keys) { typeText(comboWidget, latin1(keys)); }
    static QString latin1(const std::string& keys) {
        return QString::fromLatin1(keys.data(), std::ssize(keys));
    }
    void selectAll() { comboWidget->lineEdit()->selectAll(); }
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
    ListBox& list = this->b.list;
    int clicks = 0;
    list.onClick = [&] { ++clicks; };
    // What the window logic reads back, and the same as the user sees it.
    const auto items = [&] {
        Strings seen;
        for (int i = 0; i < list.count(); ++i) seen.emplace_back(list.itemText(i));
        EXPECT_EQ(this->b.displayed(), seen);
        return seen;
    };
    list.setItems(Strings{"b", "abc", "ABD", "Abc", "\xE9t\xE9", "\xC9T\xC9", "z"});
    list.addItem("aB");
    EXPECT_EQ(items(), (Strings{"aB", "Abc", "abc", "ABD", "b", "z", "\xC9T\xC9", "\xE9t\xE9"}));
    list.setSelected(2, true);
    list.setSelected(4, true);
    for (int i = 0; i < list.count(); ++i) EXPECT_EQ(list.selected(i), i == 4) << i;
    list.setSelected(4, false);

    // Filled again, as after an open: the same order, nothing selected.
    list.setItems(Strings{"z", "b", "ABD", "Abc", "\xE9t\xE9", "aB", "new", "\xC9T\xC9", "c"});
    EXPECT_EQ(items(),
              (Strings{"aB", "Abc", "ABD", "b", "c", "new", "z", "\xC9T\xC9", "\xE9t\xE9"}));
    for (int i = 0; i < list.count(); ++i) EXPECT_FALSE(list.selected(i)) << i;
    EXPECT_EQ(clicks, 0);
    this->b.select(2);
    this->b.select(0);
    EXPECT_EQ(clicks, 2);
    for (int i = 0; i < list.count(); ++i) EXPECT_EQ(list.selected(i), i == 0) << i;

    // One title taken out or put in, as after an edit, at the top, middle and bottom, of a
    // case-only twin and of accented titles: the order a refill gives, without a click.
    const std::pair<std::string, std::string> moves[] = {
        {"", "0"},         {"", "MMM"}, {"", "\xFFz"},  {"", "abc"},
        {"", "\xE9T\xC9"}, {"c", "zz"}, {"Abc", "ABC"}, {"\xC9T\xC9", "\xE9t\xE9"},
        {"0", ""},         {"MMM", ""}, {"\xFFz", ""},  {"aB", ""}};
    for (const auto& [out, in] : moves) {
        SCOPED_TRACE(out + " -> " + in);
        Strings titles = items();
        if (!out.empty()) {
            EXPECT_TRUE(list.removeItem(out));
            std::erase(titles, out);
        }
        if (!in.empty()) {
            list.addItem(in);
            titles.push_back(in);
        }
        EXPECT_EQ(items(), list_order::Items(titles).strings());
    }
    EXPECT_FALSE(list.removeItem("not there"));
    EXPECT_EQ(clicks, 2);
    list.clear();
    EXPECT_EQ(std::pair(clicks, list.count()), std::pair(2, 0));
}

TYPED_TEST(ControlContract, TextBoxRefusesTypingBeyondItsLengthButKeepsAssignedText) {
    auto& box = this->b.text;
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
    auto& box = this->b.combo;
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
    this->b.selectAll();  // a key typed over the selection replaces it
    this->b.type(box, "q");
    EXPECT_EQ(box.text(), "q");
    box.setEnabled(false);  // a disabled box takes no typing
    this->b.type(box, "x");
    EXPECT_EQ(std::pair(box.text(), box.isEnabled()), std::pair(std::string("q"), false));
    box.setText("assigned by code, past any limit");
    box.setItems({"new", "suggestions", "keep the text"});
    EXPECT_EQ(box.text(), "assigned by code, past any limit");
    EXPECT_EQ(box.itemCount(), 3);
}

TYPED_TEST(ControlContract, WindowLoadsOnFirstShowAndUnloadsOnEveryClosing) {
    Window& window = this->b.window;
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

// The export settings may hold a 2 (shown as neither set nor clear); it is saved back as read.
TYPED_TEST(ControlContract, CheckBoxKeepsEveryValueSetByCode) {
    CheckBox& box = this->b.check;
    for (const int value : {1, 2, 0, 2, 1}) {
        box.setValue(value);
        EXPECT_EQ(box.value(), value);
    }
}

TYPED_TEST(ControlContract, DriveChangeFiresForCodeToo) {
    DriveList& drives = this->b.drives;
    const std::string other = this->b.otherDrive();
    if (other.empty()) GTEST_SKIP() << "only one mounted volume here";
    int changes = 0;
    drives.onChange = [&] { ++changes; };
    EXPECT_TRUE(drives.setDrive(other));
    EXPECT_FALSE(drives.setDrive("no such volume"));
    EXPECT_EQ(std::pair(drives.drive(), changes), std::pair(other, 1));
}

TEST(MessageStyles, StylesMapToButtonsIconsAndDefaults) {
    using Box = QMessageBox;
    // The style, then the box's icon, whether it asks Yes/No and its default button.
    const std::tuple<int, Box::Icon, bool, Box::StandardButton> cases[] = {
        {16, Box::Critical, false, Box::Ok}, {64, Box::Information, false, Box::Ok},
        {4, Box::NoIcon, true, Box::Yes},    {260, Box::NoIcon, true, Box::No},
        {308, Box::Warning, true, Box::No},
    };
    qt::QtPlatform platform;
    for (const auto& [style, icon, yesNo, defaultButton] : cases) {
        std::optional<std::tuple<Box::Icon, bool, bool, QString, QString>> seen;
        qt::QtPlatform::setAnswerHook([&](Box& box) {
            const bool asks = box.button(Box::Yes) && box.button(Box::No) && !box.button(Box::Ok);
            seen.emplace(
                box.icon(), asks,
                static_cast<QAbstractButton*>(box.defaultButton()) == box.button(defaultButton),
                box.windowTitle(), box.text());
            return asks ? Answer::No : Answer::Ok;
        });
        const Answer answer = platform.messageBox("line one\r\nline two", style, "T\xE9tel");
        EXPECT_EQ(seen, std::tuple(icon, yesNo, true, QStringLiteral("T\xE9tel"),
                                   QStringLiteral("line one\nline two")))
            << style;
        EXPECT_EQ(answer, yesNo ? Answer::No : Answer::Ok);
    }
    qt::QtPlatform::setAnswerHook(nullptr);
}

// Without a hook the box waits for the user, and the answer is the button pressed.
TEST(MessageStyles, TheShownBoxAnswersTheButtonPressed) {
    qt::QtPlatform platform;
    for (const auto& [style, pressed, answer] : {std::tuple{4, QMessageBox::No, Answer::No},
                                                 {4, QMessageBox::Yes, Answer::Yes},
                                                 {16, QMessageBox::Ok, Answer::Ok}}) {
        QTimer presser;
        QObject::connect(&presser, &QTimer::timeout, [button = pressed] {
            if (auto* box = qobject_cast<QMessageBox*>(QApplication::activeModalWidget())) {
                box->button(button)->click();
            }
        });
        presser.start(10);
        EXPECT_EQ(platform.messageBox("Sure?", style, "Question"), answer) << style;
    }
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
    b.combo.setText("");
    int beeps = 0;
    qt::setRefusalHook([&] { ++beeps; });
    // a, euro, e-acute typed: the euro alone is refused, each time with a beep.
    typeText(b.textWidget, QString::fromUtf8("a\xE2\x82\xAC\xC3\xA9"));
    typeText(b.comboWidget, QString::fromUtf8("b\xE2\x82\xAC\xC3\xB1"));
    EXPECT_EQ(std::make_tuple(b.text.text(), b.combo.text(), beeps),
              std::make_tuple("a\xE9", "b\xF1", 2));
    // Pasted text holding a euro sign or a line break is refused whole; Latin-1 gets in.
    for (const char* pasted : {"x\xE2\x82\xACy", "two\r\nlines", "\xC3\xA4\xC3\x98\xC3\x9F"}) {
        QApplication::clipboard()->setText(QString::fromUtf8(pasted));
        b.textWidget->paste();
    }
    EXPECT_EQ(std::make_tuple(b.text.text(), beeps), std::make_tuple("a\xE9\xE4\xD8\xDF", 4));
    // A control character the program put there does not stop further typing.
    b.text.setText("tab\there");
    b.combo.setText("tab\there");
    b.type(b.text, "!");
    b.type(b.combo, "!");
    EXPECT_EQ(std::make_tuple(b.text.text(), b.combo.text(), beeps),
              std::make_tuple("tab\there!", "tab\there!", 4));
    qt::setRefusalHook(nullptr);
}

}  // namespace
