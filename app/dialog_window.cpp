#include "app/dialog_window.h"

#include <QLabel>
#include <QPainter>
#include <QPixmap>
#include <QWidget>
#include <QWindow>

namespace app {

namespace {

QPixmap disc(int size) {
    QPixmap pixmap(size, size);
    pixmap.fill(Qt::transparent);
    QPainter p(&pixmap);
    p.setRenderHint(QPainter::Antialiasing);
    const QRectF outer(1, 1, size - 2, size - 2);
    QConicalGradient shine(outer.center(), 45);
    shine.setColorAt(0.0, QColor(200, 215, 240));
    shine.setColorAt(0.25, QColor(250, 250, 255));
    shine.setColorAt(0.5, QColor(170, 190, 230));
    shine.setColorAt(0.75, QColor(245, 240, 255));
    shine.setColorAt(1.0, QColor(200, 215, 240));
    p.setPen(QPen(QColor(60, 80, 120), 1));
    p.setBrush(shine);
    p.drawEllipse(outer);
    const qreal hole = size * 0.14;
    p.setBrush(QColor(32, 58, 96));
    p.drawEllipse(outer.center(), hole, hole);
    return pixmap;
}

}  // namespace

void makeDialogWindow(QWidget* dialog, QWidget* owner) {
    dialog->setWindowFlags(Qt::Dialog | Qt::WindowTitleHint | Qt::WindowCloseButtonHint |
                           Qt::CustomizeWindowHint);
    if (owner != nullptr) {
        // The native windows exist from here on, so the owner link holds from the first show.
        dialog->winId();
        owner->winId();
        dialog->windowHandle()->setTransientParent(owner->windowHandle());
    }
}

void DialogWindow::show() {
    if (!isLoaded()) widget()->winId();
    QtWindow::show();
    // A native window made in advance keeps its old place in the stacking order, and the main
    // window is raised whenever a dialog closes: without a window manager to stack the dialog
    // above its owner, it would open hidden behind the window it disables.
    if (isLoaded()) widget()->raise();
}

QLabel* discPicture(QWidget* parent) {
    auto* label = new QLabel(parent);
    label->setPixmap(disc(32));
    label->setFixedSize(32, 32);
    return label;
}

}  // namespace app
