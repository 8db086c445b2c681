#include "app/main_window_view.h"

#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPainter>
#include <QPushButton>
#include <QShortcut>

namespace app {

namespace {

// The window's own background: a dark blue field with a few discs drawn on it.
class Backdrop : public QWidget {
  protected:
    void paintEvent(QPaintEvent*) override {
        QPainter p(this);
        p.setRenderHint(QPainter::Antialiasing);
        QLinearGradient sky(0, 0, 0, height());
        sky.setColorAt(0, QColor(32, 58, 96));
        sky.setColorAt(1, QColor(12, 22, 40));
        p.fillRect(rect(), sky);
        const QPointF centres[] = {{470, 60}, {90, 300}, {300, 140}};
        const qreal radii[] = {110, 80, 60};
        for (int i = 0; i < 3; ++i) {
            QRadialGradient shine(centres[i], radii[i]);
            shine.setColorAt(0.0, QColor(255, 255, 255, 0));
            shine.setColorAt(0.2, QColor(180, 200, 255, 30));
            shine.setColorAt(0.6, QColor(120, 160, 255, 18));
            shine.setColorAt(1.0, QColor(255, 255, 255, 0));
            p.setBrush(shine);
            p.setPen(QPen(QColor(200, 215, 255, 40), 1));
            p.drawEllipse(centres[i], radii[i], radii[i]);
            p.setBrush(Qt::NoBrush);
            p.drawEllipse(centres[i], radii[i] * 0.18, radii[i] * 0.18);
        }
    }
};

QLabel* caption(QWidget* parent) {
    auto* label = new QLabel(parent);
    QPalette palette = label->palette();
    palette.setColor(QPalette::WindowText, QColor(235, 240, 255));
    label->setPalette(palette);
    return label;
}

}  // namespace

struct MainWindowView::Adapters {
    explicit Adapters(MainWindowView& v)
        : window(v.widget()),
          Label1(v.Label1),
          List_list(v.List_list),
          Command_create(v.Command_create),
          Command_delete(v.Command_delete),
          Label2(v.Label2),
          List1(v.List1),
          Command_search(v.Command_search),
          Command_delentry(v.Command_delentry),
          Command_export(v.Command_export),
          Command_print(v.Command_print),
          Label4(v.Label4),
          Text1(v.Text1),
          Combo1(v.Combo1),
          Combo2(v.Combo2),
          Combo3(v.Combo3),
          Label3(v.Label3),
          Textart(v.Textart),
          Command_add(v.Command_add),
          Command_change(v.Command_change),
          Command_clear(v.Command_clear) {}

    ui::qt::QtWindow window;
    ui::qt::QtLabel Label1;
    ui::qt::QtListBox List_list;
    ui::qt::QtButton Command_create;
    ui::qt::QtButton Command_delete;
    ui::qt::QtLabel Label2;
    ui::qt::QtListBox List1;
    ui::qt::QtButton Command_search;
    ui::qt::QtButton Command_delentry;
    ui::qt::QtButton Command_export;
    ui::qt::QtButton Command_print;
    ui::qt::QtLabel Label4;
    ui::qt::QtTextBox Text1;
    ui::qt::QtComboBox Combo1;
    ui::qt::QtComboBox Combo2;
    ui::qt::QtComboBox Combo3;
    ui::qt::QtLabel Label3;
    ui::qt::QtTextBox Textart;
    ui::qt::QtButton Command_add;
    ui::qt::QtButton Command_change;
    ui::qt::QtButton Command_clear;
};

MainWindowView::MainWindowView() : window_(std::make_unique<Backdrop>()) {
    QWidget* w = window_.get();
    Label1 = caption(w);
    List_list = new QListWidget(w);
    Command_create = new QPushButton(w);
    Command_delete = new QPushButton(w);
    Label2 = caption(w);
    List1 = new QListWidget(w);
    Command_search = new QPushButton(w);
    Command_delentry = new QPushButton(w);
    Command_export = new QPushButton(w);
    Command_print = new QPushButton(w);
    Label4 = caption(w);
    Text1 = new QLineEdit(w);
    Combo1 = new QComboBox(w);
    Combo1->setEditable(true);
    Combo2 = new QComboBox(w);
    Combo2->setEditable(true);
    Combo3 = new QComboBox(w);
    Combo3->setEditable(true);
    Label3 = caption(w);
    Label3->setAlignment(Qt::AlignRight | Qt::AlignVCenter);
    Textart = new QLineEdit(w);
    Textart->setReadOnly(true);
    Textart->setFocusPolicy(Qt::NoFocus);
    Command_add = new QPushButton(w);
    Command_change = new QPushButton(w);
    Command_clear = new QPushButton(w);
    Label_find = caption(w);
    Label_find->setText(QStringLiteral("Find title:"));
    Text_find = new QLineEdit(w);
    Text_find->setValidator(new ui::qt::Latin1Validator(Text_find));
    Text_find->setClearButtonEnabled(true);
    a_ = std::make_unique<Adapters>(*this);
    layOut();

    QWidget* order[] = {
        Text1,          Combo1,         Combo2,         Combo3,           Command_add,
        Command_change, Command_clear,  Command_search, Command_delentry, Command_export,
        Command_print,  Command_create, Command_delete, List_list,        Text_find,
        List1};
    for (std::size_t i = 1; i < std::size(order); ++i) QWidget::setTabOrder(order[i - 1], order[i]);
}

MainWindowView::~MainWindowView() = default;

void MainWindowView::layOut() {
    const int width = 700;
    const int height = 400;
    window_->setFixedSize(width, height);

    Label1->setGeometry(12, 10, 210, 18);
    List_list->setGeometry(12, 30, 210, 212);
    Command_create->setGeometry(12, 248, 103, 28);
    Command_delete->setGeometry(119, 248, 103, 28);

    const int mid = 238;
    Command_search->setGeometry(mid, 30, 118, 28);
    Command_delentry->setGeometry(mid, 64, 118, 28);
    Command_export->setGeometry(mid, 98, 118, 28);
    Command_print->setGeometry(mid, 214, 118, 28);

    Label2->setGeometry(372, 10, 316, 18);
    Label_find->setGeometry(372, 30, 70, 24);
    Text_find->setGeometry(444, 30, 244, 24);
    List1->setGeometry(372, 58, 316, 218);

    // The column header is one text; each field starts under its word.
    const QString header =
        Label4->text().isEmpty() ? QString(main_window::kColumnHeader.c_str()) : Label4->text();
    const QFontMetrics metrics(Label4->font());
    const int left = 12;
    auto column = [&](const char* word) {
        return left + metrics.horizontalAdvance(header.left(header.indexOf(QLatin1String(word))));
    };
    const int typeX = column("Type");
    const int discsX = column("CD's");
    const int infoX = column("Information");
    Label4->setGeometry(left, 294, width - 2 * left, 18);
    const int fieldsY = 314;
    Text1->setGeometry(left, fieldsY, typeX - left - 6, 26);
    Combo1->setGeometry(typeX, fieldsY, discsX - typeX - 6, 26);
    Combo2->setGeometry(discsX, fieldsY, infoX - discsX - 6, 26);
    Combo3->setGeometry(infoX, fieldsY, width - left - infoX, 26);

    const int rowY = 354;
    Label3->setGeometry(left, rowY, 44, 26);
    Textart->setGeometry(left + 50, rowY, 60, 26);
    Command_add->setGeometry(width - left - 3 * 96 - 12, rowY, 96, 28);
    Command_change->setGeometry(width - left - 2 * 96 - 6, rowY, 96, 28);
    Command_clear->setGeometry(width - left - 96, rowY, 96, 28);
}

void MainWindowView::connectFinder(main_window::TitleFinder& finder) {
    QObject::connect(Text_find, &QLineEdit::textEdited, [&finder](const QString& text) {
        finder.Text_find_Change(ui::qt::fromQt(text));
    });
    QObject::connect(Text_find, &QLineEdit::returnPressed, [&finder] { finder.FindNext(); });
    auto* next = new QShortcut(QKeySequence(Qt::Key_F3), window_.get());
    QObject::connect(next, &QShortcut::activated, [&finder] { finder.FindNext(); });
    auto* previous = new QShortcut(QKeySequence(Qt::SHIFT | Qt::Key_F3), window_.get());
    QObject::connect(previous, &QShortcut::activated, [&finder] { finder.FindPrevious(); });
}

main_window::Form1Controls MainWindowView::controls() {
    Adapters& a = *a_;
    return {a.window,        a.Label1, a.List_list,      a.Command_create,   a.Command_delete,
            a.Label2,        a.List1,  a.Command_search, a.Command_delentry, a.Command_export,
            a.Command_print, a.Label4, a.Text1,          a.Combo1,           a.Combo2,
            a.Combo3,        a.Label3, a.Textart,        a.Command_add,      a.Command_change,
            a.Command_clear};
}

}  // namespace app
