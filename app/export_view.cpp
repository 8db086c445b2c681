#include "app/export_view.h"

#include <QBoxLayout>
#include <QCheckBox>
#include <QComboBox>
#include <QFileSystemModel>
#include <QFrame>
#include <QGridLayout>
#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QPainter>
#include <QPixmap>
#include <QPushButton>
#include <QTreeView>

#include "app/dialog_window.h"
#include "app/widgets.h"
#include "ui/qt/qt_controls.h"
#include "ui/qt/qt_folders.h"

namespace app {

namespace {

// The dialog's picture: a sheet of lines with an arrow leaving it.
QPixmap exportPicture(int size) {
    QPixmap pixmap(size, size);
    pixmap.fill(Qt::transparent);
    QPainter p(&pixmap);
    p.setRenderHint(QPainter::Antialiasing);
    const qreal unit = size / 32.0;
    p.setPen(QPen(QColor(60, 80, 120), unit));
    p.setBrush(QColor(250, 250, 255));
    p.drawRect(QRectF(3 * unit, 2 * unit, 18 * unit, 26 * unit));
    for (int line = 0; line < 5; ++line) {
        const qreal y = (8 + 4 * line) * unit;
        p.drawLine(QPointF(6 * unit, y), QPointF(18 * unit, y));
    }
    p.setPen(QPen(QColor(0, 150, 230), 2.5 * unit, Qt::SolidLine, Qt::RoundCap));
    p.drawLine(QPointF(16 * unit, 22 * unit), QPointF(29 * unit, 22 * unit));
    p.drawLine(QPointF(24 * unit, 17 * unit), QPointF(29 * unit, 22 * unit));
    p.drawLine(QPointF(24 * unit, 27 * unit), QPointF(29 * unit, 22 * unit));
    return pixmap;
}

}  // namespace

using KeyedButton = WithAccessKey<ui::qt::QtButton, QPushButton>;
using KeyedCheckBox = WithAccessKey<ui::qt::QtCheckBox, QCheckBox>;

struct ExportView::Adapters {
    explicit Adapters(ExportView& v)
        : window(v.widget()),
          Label1(v.Label1),
          Dir1(v.Dir1),
          Drive1(v.Drive1),
          Command1(v.Command1, "&Export"),
          Command2(v.Command2, "&Cancel"),
          Checkart(v.Checkart, "Include &Article number"),
          Checkhtml(v.Checkhtml, "Save as &HTML"),
          Checkcounter(v.Checkcounter, "Include co&unter"),
          Checkdate(v.Checkdate, "Include &date"),
          Checkline(v.Checkline, "Separate &line"),
          Check_lastadd(v.Check_lastadd, "Include las&t added on the list"),
          Label2(v.Label2),
          Text2(v.Text2),
          Label3(v.Label3),
          Combo1(v.Combo1),
          Check_noinfo(v.Check_noinfo),
          Text1(v.Text1) {}

    DialogWindow window;
    ui::qt::QtLabel Label1;
    ui::qt::QtDirList Dir1;
    ui::qt::QtDriveList Drive1;
    KeyedButton Command1;
    KeyedButton Command2;
    KeyedCheckBox Checkart;
    KeyedCheckBox Checkhtml;
    KeyedCheckBox Checkcounter;
    KeyedCheckBox Checkdate;
    KeyedCheckBox Checkline;
    KeyedCheckBox Check_lastadd;
    ui::qt::QtLabel Label2;
    ui::qt::QtTextBox Text2;
    ui::qt::QtLabel Label3;
    ui::qt::QtComboBox Combo1;
    ui::qt::QtCheckBox Check_noinfo;
    ui::qt::QtTextBox Text1;
};

ExportView::ExportView(QWidget* owner) : window_(std::make_unique<QWidget>()) {
    QWidget* w = window_.get();
    Frame2 = new QFrame(w);
    Frame2->setFrameShape(QFrame::Box);
    Frame2->setFrameShadow(QFrame::Sunken);
    Label1 = new QLabel(w);
    Dir1 = new QTreeView(w);
    Drive1 = new QComboBox(w);
    // Mount points can be long: the list asks for a usual width and shows them in full when open.
    Drive1->setSizeAdjustPolicy(QComboBox::AdjustToMinimumContentsLengthWithIcon);
    Drive1->setMinimumContentsLength(16);
    Command1 = new QPushButton(w);
    Command2 = new QPushButton(w);
    Image1 = new QLabel(w);
    Image1->setPixmap(exportPicture(32));
    Checkart = new QCheckBox(w);
    Checkhtml = new QCheckBox(w);
    Checkcounter = new QCheckBox(w);
    Checkdate = new QCheckBox(w);
    Checkline = new QCheckBox(w);
    Frame1 = new QGroupBox(QStringLiteral("Add last added entries"), w);
    Check_lastadd = new QCheckBox(Frame1);
    Label2 = new QLabel(Frame1);
    Text2 = new ShortLineEdit(3, Frame1);
    Label3 = new QLabel(Frame1);
    Combo1 = new QComboBox(Frame1);  // not editable: the position is picked, never typed
    Check_noinfo = new QCheckBox(w);
    Text1 = new QLineEdit(w);
    // Working controls of the export run: it sets them, the user has nothing to do with them.
    Check_noinfo->hide();
    Text1->hide();

    a_ = std::make_unique<Adapters>(*this);
    layOut();

    // The folder list reads its folders in the background, and each folder read pushes the rows
    // below it down: keep the chosen folder in sight while its parent folders are still coming.
    QFileSystemModel* folders = a_->Dir1.model();
    QTreeView* tree = Dir1;
    QObject::connect(folders, &QFileSystemModel::directoryLoaded, tree,
                     [tree, folders](const QString& loaded) {
                         const QModelIndex current = tree->currentIndex();
                         if (current.isValid() && folders->filePath(current).startsWith(loaded)) {
                             tree->scrollTo(current);
                         }
                     });

    makeDialogWindow(w, owner);
    nameField(Dir1, "Output folder", Label1);
    nameField(Drive1, "Drive");
    nameField(Text2, "Amount of last added", Label2);
    nameField(Combo1, "Place of last added", Label3);

    QWidget* order[] = {Dir1,      Drive1,       Command1,  Command2,      Checkart, Checkhtml,
                        Checkdate, Checkcounter, Checkline, Check_lastadd, Text2,    Combo1};
    for (std::size_t i = 1; i < std::size(order); ++i) QWidget::setTabOrder(order[i - 1], order[i]);
}

ExportView::~ExportView() = default;

void ExportView::layOut() {
    // Left: the folder list under its caption, the drive list at the bottom; it takes the room
    // the dialog gains. Right: the buttons beside the picture, the report options in two
    // columns, the last-added frame.
    auto* right = new QVBoxLayout;
    auto* top = new QHBoxLayout;
    auto* buttons = new QVBoxLayout;
    buttons->addWidget(Command1);
    buttons->addWidget(Command2);
    top->addLayout(buttons);
    top->addStretch();
    top->addWidget(Image1, 0, Qt::AlignTop);
    right->addLayout(top);
    right->addWidget(Checkart);
    auto* options = new QGridLayout;
    options->addWidget(Checkhtml, 0, 0);
    options->addWidget(Checkdate, 0, 1);
    options->addWidget(Checkcounter, 1, 0);
    options->addWidget(Checkline, 1, 1);
    right->addLayout(options);
    auto* lastAdded = new QGridLayout(Frame1);
    lastAdded->addWidget(Check_lastadd, 0, 0, 1, 3);
    lastAdded->addWidget(Label2, 1, 0);
    lastAdded->addWidget(Text2, 1, 1);
    lastAdded->addWidget(Label3, 2, 0);
    lastAdded->addWidget(Combo1, 2, 1, 1, 2);
    lastAdded->setColumnStretch(2, 1);
    right->addWidget(Frame1);
    right->addStretch();
    for (QPushButton* button : {Command1, Command2}) button->setMinimumWidth(120);

    auto* left = new QVBoxLayout;
    left->addWidget(Label1);
    left->addWidget(Dir1, 1);
    left->addWidget(Drive1);
    auto* columns = new QHBoxLayout(Frame2);
    columns->setContentsMargins(10, 8, 10, 10);
    columns->setSpacing(16);
    columns->addLayout(left, 1);
    columns->addLayout(right);
    auto* outer = new QVBoxLayout(window_.get());
    outer->setContentsMargins(6, 6, 6, 6);
    outer->addWidget(Frame2);
    Dir1->setMinimumSize(230, 200);
    window_->resize(QSize(540, 318).expandedTo(window_->sizeHint()));
}

exporting::Form_ExportControls ExportView::controls() {
    Adapters& a = *a_;
    return {a.window,   a.Label1,    a.Dir1,         a.Drive1,    a.Command1,     a.Command2,
            a.Checkart, a.Checkhtml, a.Checkcounter, a.Checkdate, a.Checkline,    a.Check_lastadd,
            a.Label2,   a.Text2,     a.Label3,       a.Combo1,    a.Check_noinfo, a.Text1};
}

}  // namespace app
