#pragma once

#include <memory>

#include "new_list/form_new_list.h"

class QCheckBox;
class QFrame;
class QLabel;
class QLineEdit;
class QPushButton;
class QWidget;

namespace app {

// The new-list dialog's widgets, laid out, with their control adapters. The dialog is a
// top-level window kept above `owner` (the main window).
class NewListView {
  public:
    explicit NewListView(QWidget* owner);
    ~NewListView();

    new_list::Form_new_listControls controls();
    QWidget* widget() const { return window_.get(); }

    QFrame* Frame1;
    QLabel* Image1;
    QLabel* Label1;
    QLineEdit* Text1;
    QCheckBox* Check_info;
    QPushButton* Command1;
    QPushButton* Command2;

  private:
    std::unique_ptr<QWidget> window_;
    struct Adapters;
    std::unique_ptr<Adapters> a_;
};

}  // namespace app
