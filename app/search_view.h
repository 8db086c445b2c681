#pragma once

#include <memory>

#include "search/form_searchart.h"

class QFrame;
class QLabel;
class QLineEdit;
class QPushButton;
class QWidget;

namespace app {

// The article-number search dialog's widgets, laid out, with their control adapters. The dialog
// is a top-level window kept above `owner` (the main window).
class SearchView {
  public:
    explicit SearchView(QWidget* owner);
    ~SearchView();

    search::Form_searchartControls controls();
    QWidget* widget() const { return window_.get(); }

    QFrame* Frame1;
    QLineEdit* Text1;
    QLabel* Label1;
    QPushButton* Command_search;
    QPushButton* Command_cancel;
    QLineEdit* Text2;

  private:
    std::unique_ptr<QWidget> window_;
    struct Adapters;
    std::unique_ptr<Adapters> a_;
};

}  // namespace app
