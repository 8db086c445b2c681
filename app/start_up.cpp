#include "app/start_up.h"

#include <QApplication>
#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QFont>
#include <QIcon>
#include <QMessageBox>
#include <QPainter>
#include <QPixmap>
#include <QStandardPaths>
#include <QSvgRenderer>
#include <QWidget>
#include <iostream>

#include "catalogue/catalogue_error.h"
#include "catalogue/store.h"

namespace app {

void setUpApplication() {
    QApplication::setApplicationName(QStringLiteral("pemla"));
    QApplication::setApplicationVersion(QStringLiteral(PEMLA_VERSION));
    QGuiApplication::setDesktopFileName(QStringLiteral("io.github.pemla.Pemla"));
    QApplication::setWindowIcon(programIcon());
    // The windows are drawn for this family; the size stays the one the desktop asks for.
    QFont font(QStringLiteral("DejaVu Sans"));
    font.setPointSizeF(QApplication::font().pointSizeF());
    QApplication::setFont(font);
}

QIcon programIcon() {
    QSvgRenderer picture(QStringLiteral(":/pemla/pemla.svg"));
    QIcon icon;
    for (int size : {16, 24, 32, 48, 64, 128, 256}) {
        QPixmap pixmap(size, size);
        pixmap.fill(Qt::transparent);
        QPainter painter(&pixmap);
        picture.render(&painter);
        painter.end();
        icon.addPixmap(pixmap);
    }
    return icon;
}

int refuseStart(const std::string& message) {
    QMessageBox box(QMessageBox::Critical, QStringLiteral("pemla"),
                    QString::fromLocal8Bit(message.c_str()), QMessageBox::Ok);
    box.exec();
    return 1;
}

std::string windowPlaceFile() {
    const QString folder = QStandardPaths::writableLocation(QStandardPaths::GenericConfigLocation);
    return QFile::encodeName(folder + QStringLiteral("/pemla/window")).toStdString();
}

void restoreWindowPlace(QWidget* window, const std::string& file) {
    QFile saved(QFile::decodeName(file.c_str()));
    if (saved.open(QIODevice::ReadOnly)) {
        window->restoreGeometry(QByteArray::fromBase64(saved.read(4096).trimmed()));
    }
}

void saveWindowPlace(const QWidget* window, const std::string& file) {
    const QString folder = QFileInfo(QFile::decodeName(file.c_str())).path();
    try {
        if (!QDir().mkpath(folder)) {
            throw catalogue::CatalogueError(QFile::encodeName(folder).toStdString(),
                                            "the folder cannot be made");
        }
        const QByteArray place = window->saveGeometry().toBase64() + "\r\n";
        catalogue::writeFileAtomically(file, std::string_view(place.constData(), place.size()));
    } catch (const catalogue::CatalogueError& e) {
        std::cerr << "pemla: the window's size and place are not kept: " << e.what() << std::endl;
    }
}

}  // namespace app
