#include "app/new_list_view.h"

#include <QBoxLayout>
#include <QCheckBox>
#include <QFrame>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>

#include "app/dialog_window.h"
#include "app/widgets.h"
#include "ui/qt/qt_controls.h"

namespace app {

struct NewListView::Adapters {
    explicit Adapters(NewListView& v)
        : window(v.widget()),
          Label1(v.Label1),
          Text1(v.Text1),
          Check_info(v.Check_info, "Include &information column"),
          Command1(v.Command1, "C&reate"),
          Command2(v.Command2, "&Cancel") {}

    DialogWindow window;
    ui::qt::QtLabel Label1;
    ui::qt::QtTextBox Text1;
    WithAccessKey<ui::qt::QtCheckBox, QCheckBox> Check_info;
    WithAccessKey<ui::qt::QtButton, QPushButton> Command1;
    WithAccessKey<ui::qt::QtButton, QPushButton> Command2;
};

NewListView::NewListView(QWidget* owner) : window_(std::make_unique<QWidget>()) {
    QWidget* w = window_.get();
    makeDialogWindow(w, owner);

    Frame1 = new QFrame(w);
    Frame1->setFrameShape(QFrame::StyledPanel);
    Label1 = new QLabel(Frame1);
    Label1->setAlignment(Qt::AlignCenter);
    Text1 = new QLineEdit(Frame1);
    Text1->setMinimumWidth(300);
    Check_info = new QCheckBox(Frame1);
    Image1 = discPicture(Frame1);
    Command1 = new QPushButton(Frame1);
    Command2 = new QPushButton(Frame1);

    // The prompt over the name box, the option beside the picture, then "Create" and "Cancel"
    // centred. The dialog keeps the size its contents need.
    auto* inner = new QVBoxLayout(Frame1);
    inner->addWidget(Label1);
    inner->addWidget(Text1);
    auto* option = new QHBoxLayout;
    option->addWidget(Check_info);
    option->addStretch();
    option->addWidget(Image1);
    inner->addLayout(option);
    auto* buttons = new QHBoxLayout;
    buttons->addStretch();
    buttons->addWidget(Command1);
    buttons->addWidget(Command2);
    buttons->addStretch();
    inner->addLayout(buttons);
    auto* outer = new QVBoxLayout(w);
    outer->setContentsMargins(6, 6, 6, 6);
    outer->addWidget(Frame1);
    outer->setSizeConstraint(QLayout::SetFixedSize);
    for (QPushButton* button : {Command1, Command2}) button->setMinimumWidth(120);
    nameField(Text1, "Name of the new list", Label1);

    QWidget::setTabOrder(Text1, Command1);
    QWidget::setTabOrder(Command1, Command2);
    QWidget::setTabOrder(Command2, Check_info);

    a_ = std::make_unique<Adapters>(*this);
}

NewListView::~NewListView() = default;

new_list::Form_new_listControls NewListView::controls() {
    Adapters& a = *a_;
    return {a.window, a.Label1, a.Text1, a.Check_info, a.Command1, a.Command2};
}

}  // namespace app
