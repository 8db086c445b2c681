#pragma once

#include "catalogue/entry_rules.h"
#include "catalogue/store.h"
#include "main_window/form1.h"
#include "ui/controls.h"
#include "ui/platform.h"

// The dialog that names and creates a new list.
namespace new_list {

struct Form_new_listControls {
    ui::Window& window;
    ui::Label& Label1;
    ui::TextBox& Text1;
    ui::CheckBox& Check_info;
    ui::Button& Command1;
    ui::Button& Command2;
};

inline constexpr const char* kNewListCaption = "Create new list";
inline constexpr const char* kNewListPrompt = "Name of new list (only file allowed charters!)";
using catalogue::kBadName;
using catalogue::kMaxNameLength;
using catalogue::kNameInUse;

class Form_new_list {
  public:
    // Sets the captions and the name limit and wires the dialog's events to its handlers.
    Form_new_list(const Form_new_listControls& controls, ui::Platform& platform,
                  catalogue::Store& store, main_window::Form1& form1);

    // Opening: the main window is disabled; the name box starts empty and the information
    // column is chosen, with the focus in the name box.
    void Form_Load();
    // Every closing: the main window is enabled again and brought to the front.
    void Form_Unload();

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
    main_window::Form1& form1_;
};

}  // namespace new_list
