#include <QApplication>
#include <iostream>

#include "app/command_line.h"
#include "app/command_tasks.h"
#include "app/data_folder.h"
#include "app/program.h"
#include "app/start_up.h"
#include "catalogue/catalogue_error.h"
#include "ui/qt/qt_platform.h"

// The start-up, step by step: the command line and the data folder need no display; the
// windows come last.
int main(int argc, char* argv[]) {
    app::CommandLine commandLine = app::parseCommandLine(argc, argv);
    switch (commandLine.action) {
        case app::CommandLine::Action::Help:
        case app::CommandLine::Action::Version:
            std::cout << commandLine.output << std::flush;
            return 0;
        case app::CommandLine::Action::Error:
            std::cerr << commandLine.output << std::flush;
            return 2;
        case app::CommandLine::Action::Export:
        case app::CommandLine::Action::Import:
            app::resolveCommandFiles(commandLine);
            try {
                const std::string folder =
                    app::openDataFolder(commandLine, app::processEnvironment());
                return commandLine.action == app::CommandLine::Action::Export
                           ? app::exportCommand(commandLine, folder, std::cout, std::cerr)
                           : app::importCommand(commandLine, folder, std::cout, std::cerr);
            } catch (const catalogue::CatalogueError& e) {
                std::cerr << "pemla: " << e.reason() << std::endl;
                return 1;
            }
        case app::CommandLine::Action::Run:
            break;
    }

    std::string folder;
    std::string failure;
    try {
        folder = app::openDataFolder(commandLine, app::processEnvironment());
    } catch (const catalogue::CatalogueError& e) {
        failure = e.reason();
        // Said before any window is tried, so it is seen even where none can be shown.
        std::cerr << "pemla: " << failure << std::endl;
    }

    if (!app::displayAvailable(app::processEnvironment())) {
        std::cerr << "pemla: no display found: start pemla on a desktop, or without one as: "
                     "xvfb-run -a pemla"
                  << std::endl;
        return 1;
    }
    QApplication application(argc, argv);
    app::setUpApplication();
    if (!failure.empty()) return app::refuseStart(failure);

    ui::qt::QtPlatform platform;
    app::Program program(folder, platform);
    const std::string placeFile = app::windowPlaceFile();
    app::restoreWindowPlace(program.mainWindow().widget(), placeFile);
    program.start();
    if (platform.ended()) return platform.status();
    const int status = QApplication::exec();
    app::saveWindowPlace(program.mainWindow().widget(), placeFile);
    return status;
}
