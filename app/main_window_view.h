#pragma once

#include <QWidget>
#include <memory>

#include "main_window/form1.h"
#include "main_window/title_finder.h"
#include "ui/qt/qt_controls.h"

class QComboBox;
class QHBoxLayout;
class QLabel;
class QLineEdit;
class QListView;
class QPushButton;

namespace app {

// The main window's widgets, laid out, with their control adapters.
class MainWindowView {
  public:
    MainWindowView();
    ~MainWindowView();

    main_window::Form1Controls controls();
    // Wires the "Find title" box: typing finds, Enter and F3 go to the next match, Shift+F3 to
    // the previous one (F3 anywhere in the window).
    void connectFinder(main_window::TitleFinder& finder);
    QWidget* widget() const { return window_.get(); }

    QListView* List_list;
    QListView* List1;
    QLineEdit* Text1;
    QLineEdit* Textart;
    QComboBox* Combo1;
    QComboBox* Combo2;
    QComboBox* Combo3;
    QLabel* Label1;
    QLabel* Label2;
    QLabel* Label3;
    QLabel* Label4;
    QPushButton* Command_create;
    QPushButton* Command_delete;
    QPushButton* Command_search;
    QPushButton* Command_delentry;
    QPushButton* Command_export;
    QPushButton* Command_print;
    QPushButton* Command_add;
    QPushButton* Command_change;
    QPushButton* Command_clear;
    QLabel* Label_find;
    QLineEdit* Text_find;

  private:
    void layOut();
    QHBoxLayout* fieldRow();

    std::unique_ptr<QWidget> window_;
    struct Adapters;
    std::unique_ptr<Adapters> a_;
};

}  // namespace app
