#include "app/main_window_view.h"

#include <QBoxLayout>
#include <QComboBox>
#include <QGridLayout>
#include <QKeySequence>
#include <QLabel>
#include <QLineEdit>
#include <QListView>
#include <QPainter>
#include <QPushButton>
#include <QShortcut>
#include <algorithm>

#include "app/widgets.h"

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

using KeyedButton = WithAccessKey<ui::qt::QtButton, QPushButton>;

struct MainWindowView::Adapters {
    explicit Adapters(MainWindowView& v)
        : window(v.widget()),
          Label1(v.Label1),
          List_list(v.List_list),
          Command_create(v.Command_create, "Create &new list"),
          Command_delete(v.Command_delete, "Delete &list"),
          Label2(v.Label2),
          List1(v.List1),
          Command_search(v.Command_search, "&Search Art#"),
          Command_delentry(v.Command_delentry, "&Delete entry"),
          Command_export(v.Command_export, "&Export pemla"),
          Command_print(v.Command_print, "E&xit"),
          Label4(v.Label4),
          Text1(v.Text1),
          Combo1(v.Combo1),
          Combo2(v.Combo2),
          Combo3(v.Combo3),
          Label3(v.Label3),
          Textart(v.Textart),
          Command_add(v.Command_add, "&Add"),
          Command_change(v.Command_change, "&Change"),
          Command_clear(v.Command_clear, "&Reset") {}

    ui::qt::QtWindow window;
    ui::qt::QtLabel Label1;
    ui::qt::QtListBox List_list;
    KeyedButton Command_create;
    KeyedButton Command_delete;
    ui::qt::QtLabel Label2;
    ui::qt::QtListBox List1;
    KeyedButton Command_search;
    KeyedButton Command_delentry;
    KeyedButton Command_export;
    KeyedButton Command_print;
    ui::qt::QtLabel Label4;
    ui::qt::QtTextBox Text1;
    ui::qt::QtComboBox Combo1;
    ui::qt::QtComboBox Combo2;
    ui::qt::QtComboBox Combo3;
    ui::qt::QtLabel Label3;
    ui::qt::QtTextBox Textart;
    KeyedButton Command_add;
    KeyedButton Command_change;
    KeyedButton Command_clear;
};

MainWindowView::MainWindowView() : window_(std::make_unique<Backdrop>()) {
    QWidget* w = window_.get();
    Label1 = caption(w);
    List_list = new QListView(w);
    Command_create = new QPushButton(w);
    Command_delete = new QPushButton(w);
    Label2 = caption(w);
    List1 = new QListView(w);
    Command_search = new QPushButton(w);
    Command_delentry = new QPushButton(w);
    Command_export = new QPushButton(w);
    Command_print = new QPushButton(w);
    Label4 = caption(w);
    Text1 = new QLineEdit(w);
    Combo1 = new EntryComboBox("Select type", w);
    Combo2 = new EntryComboBox("Disc(s)", w);
    Combo3 = new EntryComboBox("Info", w);
    Label3 = caption(w);
    Label3->setAlignment(Qt::AlignRight | Qt::AlignVCenter);
    Textart = new ShortLineEdit(4, w);
    Textart->setReadOnly(true);
    Textart->setFocusPolicy(Qt::NoFocus);
    Command_add = new QPushButton(w);
    Command_change = new QPushButton(w);
    Command_clear = new QPushButton(w);
    Label_find = caption(w);
    Label_find->setText(QStringLiteral("&Find title:"));
    Text_find = new QLineEdit(w);
    Text_find->setValidator(new ui::qt::StorableTextValidator(Text_find));
    Text_find->setClearButtonEnabled(true);
    a_ = std::make_unique<Adapters>(*this);
    layOut();
    // The first start opens at this size; the window grows from here.
    window_->resize(QSize(700, 400).expandedTo(window_->sizeHint()));

    nameField(List_list, "Current lists", Label1);
    nameField(List1, "Titles", Label2);
    nameField(Text1, "Title", Label4);
    nameField(Combo1, "Type");
    nameField(Combo2, "Discs");
    nameField(Combo3, "Information");
    nameField(Textart, "Article number", Label3);
    nameField(Text_find, "Find title", Label_find);
    auto* exit = new QShortcut(QKeySequence(Qt::CTRL | Qt::Key_Q), w);
    QObject::connect(exit, &QShortcut::activated, Command_print, &QPushButton::click);

    QWidget* order[] = {
        Text1,          Combo1,         Combo2,         Combo3,           Command_add,
        Command_change, Command_clear,  Command_search, Command_delentry, Command_export,
        Command_print,  Command_create, Command_delete, List_list,        Text_find,
        List1};
    for (std::size_t i = 1; i < std::size(order); ++i) QWidget::setTabOrder(order[i - 1], order[i]);
    // The window opens with the focus where the tab order starts.
    Text1->setFocus();
}

MainWindowView::~MainWindowView() = default;

void MainWindowView::layOut() {
    // Left: the lists of lists with its two buttons. Middle: the dialog buttons, Exit at the
    // bottom. Right: the titles, the tallest control. The lists take the room the window gains,
    // the titles most.
    auto* grid = new QGridLayout(window_.get());
    grid->setContentsMargins(12, 8, 12, 12);
    grid->setHorizontalSpacing(16);
    grid->setVerticalSpacing(4);
    grid->addWidget(Label1, 0, 0);
    grid->addWidget(List_list, 1, 0);
    auto* listButtons = new QHBoxLayout;
    listButtons->addWidget(Command_create);
    listButtons->addWidget(Command_delete);
    grid->addLayout(listButtons, 2, 0);
    auto* middle = new QVBoxLayout;
    for (QPushButton* button : {Command_search, Command_delentry, Command_export}) {
        middle->addWidget(button);
    }
    middle->addStretch();
    middle->addWidget(Command_print);
    grid->addLayout(middle, 1, 1);
    grid->addWidget(Label2, 0, 2);
    // The find box sits right above the titles it searches.
    auto* titles = new QVBoxLayout;
    auto* find = new QHBoxLayout;
    find->setSpacing(6);
    find->addWidget(Label_find);
    find->addWidget(Text_find, 1);
    titles->addLayout(find);
    titles->addWidget(List1, 1);
    grid->addLayout(titles, 1, 2, 2, 1);
    grid->setColumnStretch(0, 2);
    grid->setColumnStretch(2, 3);
    grid->setRowStretch(1, 1);
    grid->setRowMinimumHeight(3, 10);

    // Across the bottom: the column header over the entry fields, then the article number and
    // the entry buttons.
    grid->addWidget(Label4, 4, 0, 1, 3);
    grid->addLayout(fieldRow(), 5, 0, 1, 3);
    auto* bottom = new QHBoxLayout;
    bottom->addWidget(Label3);
    bottom->addWidget(Textart);
    bottom->addStretch();
    for (QPushButton* button : {Command_add, Command_change, Command_clear}) {
        bottom->addWidget(button);
    }
    grid->setRowMinimumHeight(6, 8);
    grid->addLayout(bottom, 7, 0, 1, 3);
}

// The column header is one text; each field starts under its word, as far as the field's own
// text lets it: a field never gets narrower than its initial text needs.
QHBoxLayout* MainWindowView::fieldRow() {
    const QString header = QString::fromLatin1(main_window::kColumnHeader.c_str());
    const QFontMetrics metrics(Label4->font());
    auto column = [&](const char* word) {
        return metrics.horizontalAdvance(header.left(header.indexOf(QLatin1String(word))));
    };
    const int spacing = 6;
    const int starts[] = {0, column("Type"), column("CD's"), column("Information")};
    QWidget* fields[] = {Text1, Combo1, Combo2};
    auto* row = new QHBoxLayout;
    row->setSpacing(spacing);
    int x = 0;
    for (int i = 0; i < 3; ++i) {
        const int width = std::max(starts[i + 1] - x - spacing, fields[i]->sizeHint().width());
        fields[i]->setFixedWidth(width);
        row->addWidget(fields[i]);
        x += width + spacing;
    }
    row->addWidget(Combo3, 1);
    return row;
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
    return {.window = a.window,
            .Label1 = a.Label1,
            .List_list = a.List_list,
            .Command_create = a.Command_create,
            .Command_delete = a.Command_delete,
            .Label2 = a.Label2,
            .List1 = a.List1,
            .Command_search = a.Command_search,
            .Command_delentry = a.Command_delentry,
            .Command_export = a.Command_export,
            .Command_print = a.Command_print,
            .Label4 = a.Label4,
            .Text1 = a.Text1,
            .Combo1 = a.Combo1,
            .Combo2 = a.Combo2,
            .Combo3 = a.Combo3,
            .Label3 = a.Label3,
            .Textart = a.Textart,
            .Command_add = a.Command_add,
            .Command_change = a.Command_change,
            .Command_clear = a.Command_clear};
}

}  // namespace app
