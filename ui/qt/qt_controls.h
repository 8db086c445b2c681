#pragma once

#include <QObject>
#include <QValidator>
#include <functional>
#include <string>
#include <vector>

#include "ui/controls.h"

class QCheckBox;
class QComboBox;
class QLabel;
class QLineEdit;
class QListView;
class QPushButton;
class QWidget;

// The window controls on Qt Widgets. Each adapter wraps a widget that the window's view owns;
// text crosses as Latin-1 bytes, and characters the files cannot hold are never typed or pasted.
namespace ui::qt {

QString toQt(const std::string& latin1);
std::string fromQt(const QString& text);

// Refuses, with a beep, an edit that brings in a character the catalogue's files cannot hold: one
// beyond Latin-1, or a control character (a CR would even split a record's line). Text set by the
// program is taken as it is; control characters it already holds do not stop later edits.
class StorableTextValidator : public QValidator {
  public:
    using QValidator::QValidator;
    State validate(QString& input, int& pos) const override;
    // The text the program is about to set.
    void setBaseline(const QString& text) { last_ = text; }

  private:
    mutable QString last_;
};

// What sounds when typed, pasted or dropped text is refused: the system beep, or for tests
// `hook` (nullptr puts the beep back).
void setRefusalHook(std::function<void()> hook);

// A top-level window. Its first show() runs onLoad; every closing (close box or unload())
// runs onUnload. A disabled window ignores its close box.
class QtWindow : public QObject, public Window {
  public:
    explicit QtWindow(QWidget* widget);
    void show() override;
    void unload() override;
    bool isLoaded() const override { return loaded_; }
    void setEnabled(bool enabled) override;
    bool isEnabled() const override;
    void bringToFront() override;
    void setCaption(const std::string& caption) override;
    QWidget* widget() const { return widget_; }

    // Once the program is ending, closings run no handler.
    static void setEnding(bool ending);

  protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

  private:
    QWidget* widget_;
    bool loaded_ = false;
    bool closingByCode_ = false;
};

class QtButton : public Button {
  public:
    explicit QtButton(QPushButton* button);
    void setCaption(const std::string& caption) override;
    void setEnabled(bool enabled) override;

  private:
    QPushButton* button_;
};

class QtLabel : public Label {
  public:
    explicit QtLabel(QLabel* label);
    void setCaption(const std::string& caption) override;
    std::string caption() const override;

  private:
    QLabel* label_;
};

// Keeps its own copy of the items in the list box's order, so reading items costs nothing and
// long lists are filled in one call.
class QtListBox : public ListBox {
  public:
    explicit QtListBox(QListView* list);
    ~QtListBox() override;
    void addItem(const std::string& text) override;
    bool removeItem(const std::string& text) override;
    void setItems(list_order::Items items) override;
    void clear() override;
    int count() const override;
    std::string_view itemText(int index) const override;
    int selectedIndex() const override;
    bool selected(int index) const override;
    void setSelected(int index, bool selected) override;
    void refresh() override;

  private:
    class Rows;
    QListView* list_;
    Rows* rows_;  // owned by the view
    QMetaObject::Connection clicks_;
    bool byCode_ = false;
};

class QtComboBox : public QObject, public ComboBox {
  public:
    explicit QtComboBox(QComboBox* combo);
    void addItem(const std::string& text) override;
    void setItems(std::vector<std::string> items) override;
    int itemCount() const override;
    std::string itemText(int index) const override;
    std::string text() const override;
    bool setText(const std::string& text) override;
    std::size_t selectedLength() const override;
    void setEnabled(bool enabled) override;
    bool isEnabled() const override;

  protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

  private:
    QComboBox* combo_;
    StorableTextValidator* validator_ = nullptr;
};

class QtTextBox : public TextBox {
  public:
    explicit QtTextBox(QLineEdit* edit);
    std::string text() const override;
    void setText(const std::string& text) override;
    int maxLength() const override { return limit_; }
    void setMaxLength(int length) override;
    void setFocus() override;
    bool hasFocus() const override;

  private:
    void applyLimit();
    QLineEdit* edit_;
    StorableTextValidator* validator_;
    int limit_ = 0;
};

class QtCheckBox : public CheckBox {
  public:
    explicit QtCheckBox(QCheckBox* box);
    void setCaption(const std::string& caption) override;
    int value() const override;
    void setValue(int value) override;

  private:
    QCheckBox* box_;
};

}  // namespace ui::qt
