#pragma once

#include <QComboBox>
#include <QLineEdit>
#include <QString>
#include <string>

#include "ui/qt/qt_controls.h"

class QLabel;
class QWidget;

// Small pieces that every window's layout shares: short fields, access keys, names for screen
// readers.
namespace app {

// A text box for a few characters (an article number, an amount): it asks for room for
// `characters` wide characters rather than a line edit's usual width.
class ShortLineEdit : public QLineEdit {
  public:
    ShortLineEdit(int characters, QWidget* parent) : QLineEdit(parent), characters_(characters) {
        setSizePolicy(QSizePolicy::Fixed, QSizePolicy::Fixed);
    }
    QSize sizeHint() const override;
    QSize minimumSizeHint() const override { return sizeHint(); }

  private:
    int characters_;
};

// An editable combo box that asks for the room its sample text (its initial text) needs, not for
// its longest item's: the items come from the user's files and may be long.
class EntryComboBox : public QComboBox {
  public:
    EntryComboBox(const char* sample, QWidget* parent);
    QSize sizeHint() const override;
    QSize minimumSizeHint() const override { return sizeHint(); }

  private:
    QString sample_;
};

// `marked` (the caption with "&" before its access key) when it is `caption` so marked, else
// `caption` with no access key; an "&" of the caption itself is shown as it is.
QString withAccessKey(const QString& caption, const QString& marked);

// A button or check box adapter whose caption, set by the window logic, gets an access key: the
// words stay as they are, one letter is underlined and Alt with it presses the control.
template <class Adapter, class Widget>
class WithAccessKey : public Adapter {
  public:
    WithAccessKey(Widget* widget, const char* marked)
        : Adapter(widget), widget_(widget), marked_(QString::fromLatin1(marked)) {}
    void setCaption(const std::string& caption) override {
        Adapter::setCaption(caption);
        widget_->setText(withAccessKey(widget_->text(), marked_));
    }

  private:
    Widget* widget_;
    QString marked_;
};

// Names `field` for screen readers (an editable combo box's text field too) and makes `label`,
// when given, its buddy.
void nameField(QWidget* field, const char* name, QLabel* label = nullptr);

}  // namespace app
