#pragma once

#include "ui/qt/qt_controls.h"

class QLabel;
class QWidget;

// What the program's dialogs share on screen.
namespace app {

// Makes `dialog` a top-level window kept above `owner`. It gets no QWidget parent: disabling the
// owner, as the dialogs do while they are open, would otherwise disable them too.
void makeDialogWindow(QWidget* dialog, QWidget* owner);

// The dialogs' window adapter. Qt drops a top-level window's native window when it closes, and
// closing a widget that has none sends no close event: a dialog whose load handler closes it again
// (a search on a list without its article file) would then never unload. Each opening therefore
// makes the native window first.
class DialogWindow : public ui::qt::QtWindow {
  public:
    using QtWindow::QtWindow;
    void show() override;
};

// A label showing the dialogs' picture, a small disc, for the corner of a dialog.
QLabel* discPicture(QWidget* parent);

}  // namespace app
