#include "app/new_list_view.h"

#include <QCheckBox>
#include <QFrame>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>

#include "app/dialog_window.h"
#include "ui/qt/qt_controls.h"

namespace app {

struct NewListView::Adapters {
    explicit Adapters(NewListView& v)
        : window(v.widget()),
          Label1(v.Label1),
          Text1(v.Text1),
          Check_info(v.Check_info),
          Command1(v.Command1),
          Command2(v.Command2) {}

    DialogWindow window;
    ui::qt::QtLabel Label1;
    ui::qt::QtTextBox Text1;
    ui::qt::QtCheckBox Check_info;
    ui::qt::QtButton Command1;
    ui::qt::QtButton Command2;
};

NewListView::NewListView(QWidget* owner) : window_(std::make_unique<QWidget>()) {
    QWidget* w = window_.get();
    makeDialogWindow(w, owner, QSize(360, 164));

    Frame1 = new QFrame(w);
    Frame1->setFrameShape(QFrame::StyledPanel);
    Frame1->setGeometry(6, 6, 348, 152);
    Label1 = new QLabel(Frame1);
    Label1->setAlignment(Qt::AlignCenter);
    Label1->setGeometry(10, 10, 328, 20);
    Text1 = new QLineEdit(Frame1);
    Text1->setGeometry(10, 36, 328, 26);
    Check_info = new QCheckBox(Frame1);
    Check_info->setGeometry(10, 72, 260, 22);
    Image1 = discPicture(Frame1);
    Image1->move(306, 68);
    // "Create" on the left, the pair centred under the name box.
    Command1 = new QPushButton(Frame1);
    Command1->setGeometry(50, 110, 120, 30);
    Command2 = new QPushButton(Frame1);
    Command2->setGeometry(178, 110, 120, 30);

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
