#include "app/search_view.h"

#include <QFrame>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>

#include "app/dialog_window.h"
#include "ui/qt/qt_controls.h"

namespace app {

struct SearchView::Adapters {
    explicit Adapters(SearchView& v)
        : window(v.widget()),
          Text1(v.Text1),
          Label1(v.Label1),
          Command_search(v.Command_search),
          Command_cancel(v.Command_cancel),
          Text2(v.Text2) {}

    DialogWindow window;
    ui::qt::QtTextBox Text1;
    ui::qt::QtLabel Label1;
    ui::qt::QtButton Command_search;
    ui::qt::QtButton Command_cancel;
    ui::qt::QtTextBox Text2;
};

SearchView::SearchView(QWidget* owner) : window_(std::make_unique<QWidget>()) {
    QWidget* w = window_.get();
    makeDialogWindow(w, owner, QSize(460, 96));

    Frame1 = new QFrame(w);
    Frame1->setFrameShape(QFrame::StyledPanel);
    Frame1->setGeometry(6, 6, 448, 84);
    // Buttons on the left; the number and its hint beside "Search", the title beside "Cancel".
    Command_search = new QPushButton(Frame1);
    Command_search->setGeometry(10, 10, 90, 28);
    Command_cancel = new QPushButton(Frame1);
    Command_cancel->setGeometry(10, 46, 90, 28);
    Text1 = new QLineEdit(Frame1);
    Text1->setGeometry(108, 11, 56, 26);
    Label1 = new QLabel(Frame1);
    Label1->setGeometry(172, 11, 266, 26);
    Text2 = new QLineEdit(Frame1);
    Text2->setGeometry(108, 47, 330, 26);
    Text2->setReadOnly(true);

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
