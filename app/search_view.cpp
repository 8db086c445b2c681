#include "app/search_view.h"

#include <QBoxLayout>
#include <QFrame>
#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>

#include "app/dialog_window.h"
#include "app/widgets.h"
#include "ui/qt/qt_controls.h"

namespace app {

struct SearchView::Adapters {
    explicit Adapters(SearchView& v)
        : window(v.widget()),
          Text1(v.Text1),
          Label1(v.Label1),
          Command_search(v.Command_search, "&Search"),
          Command_cancel(v.Command_cancel, "&Cancel"),
          Text2(v.Text2) {}

    DialogWindow window;
    ui::qt::QtTextBox Text1;
    ui::qt::QtLabel Label1;
    WithAccessKey<ui::qt::QtButton, QPushButton> Command_search;
    WithAccessKey<ui::qt::QtButton, QPushButton> Command_cancel;
    ui::qt::QtTextBox Text2;
};

SearchView::SearchView(QWidget* owner) : window_(std::make_unique<QWidget>()) {
    QWidget* w = window_.get();
    makeDialogWindow(w, owner);

    Frame1 = new QFrame(w);
    Frame1->setFrameShape(QFrame::StyledPanel);
    Command_search = new QPushButton(Frame1);
    Command_cancel = new QPushButton(Frame1);
    Text1 = new ShortLineEdit(4, Frame1);
    Label1 = new QLabel(Frame1);
    Text2 = new QLineEdit(Frame1);
    Text2->setReadOnly(true);
    Text2->setMinimumWidth(330);

    // Buttons on the left; the number and its hint beside "Search", the title beside "Cancel".
    auto* grid = new QGridLayout(Frame1);
    grid->addWidget(Command_search, 0, 0);
    grid->addWidget(Text1, 0, 1);
    grid->addWidget(Label1, 0, 2);
    grid->addWidget(Command_cancel, 1, 0);
    grid->addWidget(Text2, 1, 1, 1, 2);
    grid->setColumnStretch(2, 1);
    auto* outer = new QVBoxLayout(w);
    outer->setContentsMargins(6, 6, 6, 6);
    outer->addWidget(Frame1);
    outer->setSizeConstraint(QLayout::SetFixedSize);
    for (QPushButton* button : {Command_search, Command_cancel}) button->setMinimumWidth(90);
    nameField(Text1, "Article number", Label1);
    nameField(Text2, "Title found");

    QWidget::setTabOrder(Text1, Command_search);
    QWidget::setTabOrder(Command_search, Command_cancel);
    QWidget::setTabOrder(Command_cancel, Text2);

    a_ = std::make_unique<Adapters>(*this);
}

SearchView::~SearchView() = default;

search::Form_searchartControls SearchView::controls() {
    Adapters& a = *a_;
    return {a.window, a.Text1, a.Label1, a.Command_search, a.Command_cancel, a.Text2};
}

}  // namespace app
