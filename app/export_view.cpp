#include "app/export_view.h"

#include <QCheckBox>
#include <QComboBox>
#include <QFileSystemModel>
#include <QFrame>
#include <QGroupBox>
#include <QIcon>
#include <QLabel>
#include <QLineEdit>
#include <QPainter>
#include <QPixmap>
#include <QPushButton>
#include <QTreeView>
#include <QWindow>

#include "app/dialog_window.h"
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

struct ExportView::Adapters {
    explicit Adapters(ExportView& v)
        : window(v.widget()),
          Label1(v.Label1),
          Dir1(v.Dir1),
          Drive1(v.Drive1),
          Command1(v.Command1),
          Command2(v.Command2),
          Checkart(v.Checkart),
          Checkhtml(v.Checkhtml),
          Checkcounter(v.Checkcounter),
          Checkdate(v.Checkdate),
          Checkline(v.Checkline),
          Check_lastadd(v.Check_lastadd),
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
    ui::qt::QtButton Command1;
    ui::qt::QtButton Command2;
    ui::qt::QtCheckBox Checkart;
    ui::qt::QtCheckBox Checkhtml;
    ui::qt::QtCheckBox Checkcounter;
    ui::qt::QtCheckBox Checkdate;
    ui::qt::QtCheckBox Checkline;
    ui::qt::QtCheckBox Check_lastadd;
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
    Text2 = new QLineEdit(Frame1);
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

    w->setWindowFlags(Qt::Dialog | Qt::WindowTitleHint | Qt::WindowCloseButtonHint |
                      Qt::CustomizeWindowHint);
    w->setWindowIcon(QIcon(exportPicture(32)));
    if (owner != nullptr) {
        // Native windows exist from here on, so the dialog stays above its owner from its first
        // show.
        w->winId();
        owner->winId();
        w->windowHandle()->setTransientParent(owner->windowHandle());
    }

    QWidget* order[] = {Dir1,      Drive1,       Command1,  Command2,      Checkart, Checkhtml,
                        Checkdate, Checkcounter, Checkline, Check_lastadd, Text2,    Combo1};
    for (std::size_t i = 1; i < std::size(order); ++i) QWidget::setTabOrder(order[i - 1], order[i]);
}

ExportView::~ExportView() = default;

void ExportView::layOut() {
    const int width = 540;
    const int height = 318;
    window_->setFixedSize(width, height);
    Frame2->setGeometry(6, 6, width - 12, height - 12);

    // Left: the folder list under its caption, the drive list at the bottom.
    Label1->setGeometry(16, 14, 220, 18);
    Dir1->setGeometry(16, 34, 230, 236);
    Drive1->setGeometry(16, 276, 230, 26);

    // Right: the buttons, the report options in two columns, the last-added frame.
    const int right = 262;
    Command1->setGeometry(right, 14, 120, 28);
    Command2->setGeometry(right, 48, 120, 28);
    Image1->setGeometry(width - 16 - 32, 16, 32, 32);
    Checkart->setGeometry(right, 86, 260, 22);
    Checkhtml->setGeometry(right, 112, 130, 22);
    Checkcounter->setGeometry(right, 136, 130, 22);
    Checkdate->setGeometry(right + 136, 112, 124, 22);
    Checkline->setGeometry(right + 136, 136, 124, 22);

    Frame1->setGeometry(right, 168, width - right - 16, 134);
    Check_lastadd->setGeometry(10, 24, 240, 22);
    Label2->setGeometry(10, 58, 160, 24);
    Text2->setGeometry(176, 58, 40, 24);
    Label3->setGeometry(10, 94, 160, 24);
    Combo1->setGeometry(176, 94, 80, 26);

    Check_noinfo->setGeometry(right, 168, 240, 22);
    Text1->setGeometry(right, 196, 240, 24);
}

exporting::Form_ExportControls ExportView::controls() {
    Adapters& a = *a_;
    return {a.window,   a.Label1,    a.Dir1,         a.Drive1,    a.Command1,     a.Command2,
            a.Checkart, a.Checkhtml, a.Checkcounter, a.Checkdate, a.Checkline,    a.Check_lastadd,
            a.Label2,   a.Text2,     a.Label3,       a.Combo1,    a.Check_noinfo, a.Text1};
}

}  // namespace app
