// The whole program as main() builds it, driven offscreen only through its widgets: a list is
// created, filled, edited, searched, exported and deleted, and every file it leaves behind is
// compared byte for byte with files written out by hand.
#include <gtest/gtest.h>

#include <QCheckBox>
#include <QComboBox>
#include <QFileSystemModel>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QMessageBox>
#include <QPushButton>
#include <QStyleOptionButton>
#include <QTest>
#include <QTreeView>
#include <cstdlib>
#include <deque>
#include <filesystem>
#include <fstream>
#include <map>
#include <optional>
#include <sstream>

#include "app/program.h"
#include "tests/support/temp_folder.h"
#include "ui/qt/qt_controls.h"
#include "ui/qt/qt_platform.h"

namespace {

namespace fs = std::filesystem;

const std::string kData = PEMLA_E2E_DATA;

std::string readBytes(const fs::path& file) {
    std::ifstream in(file, std::ios::binary);
    std::ostringstream bytes;
    bytes << in.rdbuf();
    return bytes.str();
}

// Every regular file of a folder by name, with its bytes.
std::map<std::string, std::string> filesOf(const fs::path& folder) {
    std::map<std::string, std::string> files;
    for (const auto& item : fs::directory_iterator(folder)) {
        files[item.path().filename().string()] =
            item.is_regular_file() ? readBytes(item.path()) : "(not a regular file)";
    }
    return files;
}

// The first line where two file texts differ, for a readable failure.
std::string firstDifference(const std::string& actual, const std::string& expected) {
    std::istringstream a(actual);
    std::istringstream e(expected);
    std::string lineA;
    std::string lineE;
    for (int line = 1;; ++line) {
        const bool moreA = static_cast<bool>(std::getline(a, lineA, '\n'));
        const bool moreE = static_cast<bool>(std::getline(e, lineE, '\n'));
        if (!moreA && !moreE) return "same lines, different bytes";
        if (lineA != lineE || moreA != moreE) {
            return "line " + std::to_string(line) + "\n  actual:   " + (moreA ? lineA : "(end)") +
                   "\n  expected: " + (moreE ? lineE : "(end)");
        }
    }
}

// Compares `folder` with the expected folder: the same file names and the same bytes. In
// export.dat the token @OUTPUT@ stands for the output folder, which only the test knows.
void expectFolder(const fs::path& folder, const std::string& expectedFolder,
                  const std::string& output = {}) {
    std::map<std::string, std::string> expected = filesOf(kData + "/" + expectedFolder);
    if (auto settings = expected.find("export.dat"); settings != expected.end()) {
        const std::string token = "@OUTPUT@";
        settings->second.replace(settings->second.find(token), token.size(), output);
    }
    const std::map<std::string, std::string> actual = filesOf(folder);
    std::string actualNames;
    std::string expectedNames;
    for (const auto& [name, bytes] : actual) actualNames += name + " ";
    for (const auto& [name, bytes] : expected) expectedNames += name + " ";
    EXPECT_EQ(actualNames, expectedNames) << "files of " << folder << " vs " << expectedFolder;
    for (const auto& [name, bytes] : expected) {
        const auto found = actual.find(name);
        if (found == actual.end()) continue;
        EXPECT_TRUE(found->second == bytes)
            << expectedFolder << "/" << name << ": " << firstDifference(found->second, bytes);
    }
}

// The message boxes the test expects, in order, each with the answer the user gives. A box
// that was not expected fails the test and is answered No (or OK).
class ScriptedBoxes {
  public:
    ScriptedBoxes() {
        ui::qt::QtPlatform::setAnswerHook([this](QMessageBox& box) { return answer(box); });
    }
    ~ScriptedBoxes() { ui::qt::QtPlatform::setAnswerHook(nullptr); }

    void expect(const std::string& title, const std::string& text, ui::Answer answer) {
        script_.push_back({title, text, answer});
    }
    // Every expected box has been shown.
    void expectAllShown() {
        EXPECT_TRUE(script_.empty())
            << script_.size() << " expected boxes not shown, first: " << script_.front().title
            << ": " << script_.front().text;
        script_.clear();
    }

  private:
    struct Box {
        std::string title;
        std::string text;
        ui::Answer answer;
    };

    ui::Answer answer(QMessageBox& box) {
        const std::string title = ui::qt::fromQt(box.windowTitle());
        const std::string text = ui::qt::fromQt(box.text());
        const bool yesNo = box.button(QMessageBox::Yes) != nullptr;
        if (script_.empty()) {
            ADD_FAILURE() << "unexpected box " << title << ": " << text;
            return yesNo ? ui::Answer::No : ui::Answer::Ok;
        }
        const Box next = script_.front();
        script_.pop_front();
        EXPECT_EQ(title + ": " + text, next.title + ": " + next.text);
        EXPECT_TRUE(box.isEnabled()) << text;
        return next.answer;
    }

    std::deque<Box> script_;
};

// A user's hands on the program's widgets.
void click(QPushButton* button) {
    ASSERT_TRUE(button->isVisible() && button->isEnabled()) << button->text().toStdString();
    QTest::mouseClick(button, Qt::LeftButton);
}

void tick(QCheckBox* box) {
    QStyleOptionButton option;
    option.initFrom(box);
    const QRect indicator =
        box->style()->subElementRect(QStyle::SE_CheckBoxIndicator, &option, box);
    QTest::mouseClick(box, Qt::LeftButton, {}, indicator.center());
}

void pick(QListWidget* list, const QString& text) {
    const auto found = list->findItems(text, Qt::MatchExactly);
    ASSERT_EQ(found.size(), 1) << text.toStdString();
    list->scrollToItem(found.front());
    QTest::mouseClick(list->viewport(), Qt::LeftButton, {},
                      list->visualItemRect(found.front()).center());
    ASSERT_TRUE(found.front()->isSelected()) << text.toStdString();
}

// Types `text` key by key. QTest's own typing knows only ASCII keys, so the accented letters
// are sent as the key of the letter carrying its text, as a keyboard sends them.
void typeText(QWidget* field, const QString& text) {
    for (QChar c : text) {
        if (c.unicode() < 0x80) {
            QTest::keyClick(field, static_cast<char>(c.unicode()));
            continue;
        }
        const auto key = static_cast<Qt::Key>(c.toUpper().unicode());
        QTest::sendKeyEvent(QTest::Press, field, key, QString(c), Qt::NoModifier);
        QTest::sendKeyEvent(QTest::Release, field, key, QString(c), Qt::NoModifier);
    }
}

// Empties a text field with End and Backspace (a full combo box still takes Backspace), then
// types `text`.
void retype(QWidget* field, const QString& current, const QString& text) {
    field->setFocus();
    QTest::keyClick(field, Qt::Key_End);
    for (qsizetype i = 0; i < current.size(); ++i) QTest::keyClick(field, Qt::Key_Backspace);
    typeText(field, text);
}

void retype(QLineEdit* edit, const QString& text) {
    retype(edit, edit->text(), text);
}
void retype(QComboBox* combo, const QString& text) {
    retype(combo, combo->currentText(), text);
}

// Clicks a folder shown in a folder list, once the list has read it from disk.
void pickFolder(QTreeView* tree, const std::string& path) {
    auto* model = static_cast<QFileSystemModel*>(tree->model());
    QModelIndex index;
    const bool shown = QTest::qWaitFor(
        [&] {
            index = model->index(QString::fromStdString(path));
            if (!index.isValid()) return false;
            tree->scrollTo(index);
            return !tree->visualRect(index).isEmpty();
        },
        10000);
    ASSERT_TRUE(shown) << path << " never shown in the folder list";
    QTest::mouseClick(tree->viewport(), Qt::LeftButton, {}, tree->visualRect(index).center());
}

QString latin1(const char* text) {
    return QString::fromLatin1(text);
}

// Points HOME at a folder of the test for as long as it lives: the export dialog's first
// output folder is the home folder.
class HomeFolder {
  public:
    explicit HomeFolder(const std::string& path) {
        if (const char* old = std::getenv("HOME")) old_ = old;
        ::setenv("HOME", path.c_str(), 1);
    }
    ~HomeFolder() {
        if (old_) {
            ::setenv("HOME", old_->c_str(), 1);
        } else {
            ::unsetenv("HOME");
        }
    }

  private:
    std::optional<std::string> old_;
};

struct Entry {
    const char* title;
    const char* type;
    const char* discs;
    const char* information;
};

TEST(ProgramEndToEnd, CreateFillEditSearchExportAndDeleteAList) {
    test_support::TempFolder work;
    test_support::TempFolder home;
    const HomeFolder homeFolder(home.path());
    const fs::path reports = fs::path(home.path()) / "reports";
    fs::create_directory(reports);
    fs::copy(kData + "/start", work.path());

    ScriptedBoxes boxes;
    ui::qt::QtPlatform platform;
    app::Program program(work.path(), platform);
    app::MainWindowView& main = program.mainWindow();
    QWidget* mainWidget = main.widget();
    program.start();
    ASSERT_FALSE(platform.ended());
    ASSERT_TRUE(mainWidget->isVisible());
    ASSERT_EQ(main.List_list->count(), 1);

    // A new list, with its information column.
    click(main.Command_create);
    app::NewListView& newList = program.newListDialog();
    ASSERT_TRUE(newList.widget()->isVisible());
    EXPECT_FALSE(mainWidget->isEnabled());
    EXPECT_TRUE(newList.Check_info->isChecked());
    QTest::keyClicks(newList.Text1, QStringLiteral("Films"));
    click(newList.Command1);
    EXPECT_FALSE(newList.widget()->isVisible());
    ASSERT_TRUE(mainWidget->isEnabled());
    ASSERT_EQ(main.List_list->count(), 2);

    pick(main.List_list, QStringLiteral("Films"));
    ASSERT_EQ(main.List1->count(), 1);
    EXPECT_EQ(main.Label2->text(), QStringLiteral("... amount:  1 ..."));

    // Three entries.
    const Entry added[] = {{"Am\xe9lie", "DVD video", "1", "Original"},
                           {"Brazil", "Blu-ray video", "2", "Copy"},
                           {"Casablanca", "DVD video", "1", "Boxed"}};
    for (const Entry& entry : added) {
        retype(main.Text1, latin1(entry.title));
        retype(main.Combo1, latin1(entry.type));
        retype(main.Combo2, latin1(entry.discs));
        retype(main.Combo3, latin1(entry.information));
        click(main.Command_add);
        EXPECT_TRUE(main.Text1->text().isEmpty()) << entry.title;
    }
    ASSERT_EQ(main.List1->count(), 4);
    EXPECT_EQ(main.Label2->text(), QStringLiteral("... amount:  4 ..."));

    // Brazil becomes a title of another letter: it gets a new article number.
    pick(main.List1, QStringLiteral("Brazil"));
    EXPECT_EQ(main.Textart->text(), QStringLiteral("B001"));
    EXPECT_EQ(main.Combo1->currentText(), QStringLiteral("Blu-ray video"));
    retype(main.Text1, latin1("Zazie dans le m\xe9tro"));
    retype(main.Combo1, QStringLiteral("DVD video"));
    retype(main.Combo3, QStringLiteral("Signed"));
    boxes.expect("Change item", "Are ya sure yo want to change selected entry?", ui::Answer::Yes);
    click(main.Command_change);
    boxes.expectAllShown();
    pick(main.List1, latin1("Zazie dans le m\xe9tro"));
    EXPECT_EQ(main.Textart->text(), QStringLiteral("Z001"));

    pick(main.List1, QStringLiteral("Casablanca"));
    boxes.expect("Change item", "Are ya sure yo want to DELETE selected entry?", ui::Answer::Yes);
    click(main.Command_delentry);
    boxes.expectAllShown();
    EXPECT_EQ(main.List1->count(), 3);

    // The search finds the changed title by its number, typed in small letters.
    click(main.Command_search);
    app::SearchView& search = program.searchDialog();
    ASSERT_TRUE(search.widget()->isVisible());
    EXPECT_FALSE(mainWidget->isEnabled());
    QTest::keyClicks(search.Text1, QStringLiteral("z001"));
    click(search.Command_search);
    EXPECT_EQ(search.Text2->text(), latin1("Zazie dans le m\xe9tro"));
    click(search.Command_cancel);
    EXPECT_FALSE(search.widget()->isVisible());
    ASSERT_TRUE(mainWidget->isEnabled());

    // Export: first as text with article numbers and the last two added below the table.
    click(main.Command_export);
    app::ExportView& exporter = program.exportDialog();
    ASSERT_TRUE(exporter.widget()->isVisible());
    EXPECT_FALSE(mainWidget->isEnabled());
    EXPECT_EQ(program.exportDialog().controls().Dir1.path(), home.path());
    pickFolder(exporter.Dir1, reports.string());
    ASSERT_EQ(exporter.controls().Dir1.path(), reports.string());
    EXPECT_FALSE(exporter.Checkdate->isChecked());  // the report carries no date
    tick(exporter.Checkart);
    tick(exporter.Checkline);
    tick(exporter.Checkcounter);
    tick(exporter.Check_lastadd);
    retype(exporter.Text2, QStringLiteral("2"));
    exporter.Combo1->setFocus();
    QTest::keyClick(exporter.Combo1, Qt::Key_Down);
    EXPECT_EQ(exporter.Combo1->currentText(), QStringLiteral("Bottom"));
    boxes.expect("Done", "Export done!", ui::Answer::Ok);
    click(exporter.Command1);
    boxes.expectAllShown();

    // Then as an HTML page without article numbers, the last two added on top.
    tick(exporter.Checkart);
    tick(exporter.Checkhtml);
    QTest::keyClick(exporter.Combo1, Qt::Key_Up);
    EXPECT_EQ(exporter.Combo1->currentText(), QStringLiteral("Top"));
    boxes.expect("Done", "Export done!", ui::Answer::Ok);
    click(exporter.Command1);
    boxes.expectAllShown();
    click(exporter.Command2);
    EXPECT_FALSE(exporter.widget()->isVisible());
    ASSERT_TRUE(mainWidget->isEnabled());

    expectFolder(work.path(), "before-delete", reports.string());
    expectFolder(reports, "out");

    // The list goes, after two confirmations; the other list stays as it was.
    pick(main.List_list, QStringLiteral("Films"));
    boxes.expect("DELETE?", "ARE YA SURE YA WANT TO DELETE THE SELECTED LIST?", ui::Answer::Yes);
    boxes.expect("DELETE?", "ARE YA REALLY SURE?", ui::Answer::Yes);
    click(main.Command_delete);
    boxes.expectAllShown();
    ASSERT_EQ(main.List_list->count(), 1);
    EXPECT_EQ(main.List1->count(), 0);

    expectFolder(work.path(), "end", reports.string());
    expectFolder(reports, "out");
}

}  // namespace
