#pragma once

#include <memory>

#include "export/form_export.h"

class QCheckBox;
class QComboBox;
class QFrame;
class QGroupBox;
class QLabel;
class QLineEdit;
class QPushButton;
class QTreeView;
class QWidget;

namespace app {

// The export dialog's widgets, laid out, with their control adapters. The dialog is a top-level
// window without a parent, kept above `owner`, so disabling the main window leaves it usable.
// The working controls Check_noinfo and Text1 exist but are hidden: the user never sets them.
class ExportView {
  public:
    explicit ExportView(QWidget* owner = nullptr);
    ~ExportView();

    exporting::Form_ExportControls controls();
    QWidget* widget() const { return window_.get(); }

    QFrame* Frame2;
    QLabel* Label1;
    QTreeView* Dir1;
    QComboBox* Drive1;
    QPushButton* Command1;
    QPushButton* Command2;
    QLabel* Image1;
    QCheckBox* Checkart;
    QCheckBox* Checkhtml;
    QCheckBox* Checkcounter;
    QCheckBox* Checkdate;
    QCheckBox* Checkline;
    QGroupBox* Frame1;
    QCheckBox* Check_lastadd;
    QLabel* Label2;
    QLineEdit* Text2;
    QLabel* Label3;
    QComboBox* Combo1;
    QCheckBox* Check_noinfo;
    QLineEdit* Text1;

  private:
    void layOut();

    std::unique_ptr<QWidget> window_;
    struct Adapters;
    std::unique_ptr<Adapters> a_;
};

}  // namespace app
