#pragma once

#include <functional>
#include <string>

#include "ui/controls.h"

// What the dialogs reach of the main window, and nothing more.
namespace main_window {

// A refusal the user is told about in a message box (title "Error", style 16).
struct Refusal {
    std::string prompt;
};

class MainWindowLink {
  public:
    virtual ~MainWindowLink() = default;

    // The list selected in the list of lists, or an empty text when none is selected.
    virtual std::string selectedList() const = 0;
    // The open list's titles as the main window shows them.
    virtual const ui::ListBox& titles() const = 0;
    // Refills the list of lists from the list index and empties the titles. Throws
    // CatalogueError.
    virtual void LoadListNames() = 0;
    // Shows a catalogue failure, naming the file and the reason, as every handler does.
    virtual void showError(const std::string& file, const std::string& reason) = 0;
    // Runs a handler body as the main window runs its own: a catalogue failure or a Refusal is
    // shown in a message box and the windows stay usable; with the busy pointer when asked.
    virtual void guarded(const std::function<void()>& body, bool busy = false) = 0;
    // The main window takes input, or not, while a dialog is open.
    virtual void setEnabled(bool enabled) = 0;
    // Brings the main window to the front.
    virtual void bringToFront() = 0;
};

// The part every dialog of the main window shares: the main window takes no input while the
// dialog is open. Loading the dialog's window disables the main window, then runs Form_Load;
// every closing runs Form_Unload, then enables the main window and brings it to the front.
class MainWindowDialog {
  public:
    MainWindowDialog(const MainWindowDialog&) = delete;
    MainWindowDialog& operator=(const MainWindowDialog&) = delete;

    // What the dialog does when it opens and when it closes, around the main window's turn.
    virtual void Form_Load() {}
    virtual void Form_Unload() {}

  protected:
    MainWindowDialog(ui::Window& window, MainWindowLink& main);
    ~MainWindowDialog() = default;

    MainWindowLink& main_;
};

}  // namespace main_window
