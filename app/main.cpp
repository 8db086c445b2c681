#include <QApplication>
#include <QFont>

#include "app/program.h"
#include "ui/qt/qt_platform.h"

// The program works on the catalogue in its working folder.
int main(int argc, char* argv[]) {
    QApplication application(argc, argv);
    QApplication::setApplicationName(QStringLiteral("pemla"));
    QApplication::setFont(QFont(QStringLiteral("DejaVu Sans"), 9));

    ui::qt::QtPlatform platform;
    app::Program program(".", platform);
    program.start();
    if (platform.ended()) return platform.status();
    return QApplication::exec();
}
