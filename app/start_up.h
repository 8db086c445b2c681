#pragma once

#include <string>

class QIcon;
class QWidget;

// The program's Qt side of starting and ending: its name and icon for the desktop, the refusal
// to start, and the main window's size and place kept between runs.
namespace app {

// Names the program for the desktop (so task bars find its .desktop entry and icon) and gives
// every window the program's icon and font, at the desktop's font size. Needs the QApplication.
void setUpApplication();

// The program's icon, drawn from its built-in picture.
QIcon programIcon();

// Tells the user why the program cannot start, in a message box, and returns the exit status.
int refuseStart(const std::string& message);

// The file keeping the main window's size and place, in the user's config folder.
std::string windowPlaceFile();

// Gives `window` the size and place of the last run; without one (or one that cannot be read) it
// keeps the size it was made with.
void restoreWindowPlace(QWidget* window, const std::string& file);

// Keeps `window`'s size and place for the next run. A failure is reported on standard error only:
// the catalogue is not affected and the program is ending.
void saveWindowPlace(const QWidget* window, const std::string& file);

}  // namespace app
