#pragma once

#include "catalogue/entry_rules.h"
#include "catalogue/store.h"
#include "main_window/main_window_link.h"
#include "ui/controls.h"
#include "ui/platform.h"

// The dialog that names and creates a new list.
namespace new_list {

struct Form_new_listControls {
    ui::Window& window;        // the dialog
    ui::Label& Label1;         // prompt
    ui::TextBox& Text1;        // name of the new list
    ui::CheckBox& Check_info;  // include information column
    ui::Button& Command1;      // Create
    ui::Button& Command2;      // Cancel
};

inline constexpr const char* kNewListCaption = "Create new list";
inline constexpr const char* kNewListPrompt = "Name of new list (only file allowed charters!)";
using catalogue::kBadName;
using catalogue::kMaxNameLength;
using catalogue::kNameInUse;

class Form_new_list : public main_window::MainWindowDialog {
  public:
    // Sets the captions and the name limit and wires the dialog's events to its handlers.
    Form_new_list(const Form_new_listControls& controls, ui::Platform& platform,
                  catalogue::Store& store, main_window::MainWindowLink& main);

    // Opening: the name box starts empty and the information column is chosen, with the focus
    // in the name box.
    void Form_Load() override;

    // "Create": tries the name, refuses one in use or reserved, otherwise writes the index line
    // and the new list's files as one change and refills the main window's lists. Refusals and
    // failures are shown in a message box; the dialog closes whatever the outcome.
    void Command1_Click();
    // "Cancel": closes the dialog.
    void Command2_Click();

  private:
    void createList();

    Form_new_listControls c_;
    ui::Platform& platform_;
    catalogue::Store& store_;
};

}  // namespace new_list
