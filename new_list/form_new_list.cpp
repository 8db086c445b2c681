#include "new_list/form_new_list.h"

#include <string>

#include "catalogue/list_edits.h"

namespace new_list {

Form_new_list::Form_new_list(const Form_new_listControls& controls, ui::Platform& platform,
                             catalogue::Store& store, main_window::MainWindowLink& main)
    : MainWindowDialog(controls.window, main), c_(controls), platform_(platform), store_(store) {
    c_.window.setCaption(kNewListCaption);
    c_.Label1.setCaption(kNewListPrompt);
    c_.Text1.setMaxLength(kMaxNameLength);
    c_.Check_info.setCaption("Include information column");
    c_.Check_info.setValue(1);
    c_.Command1.setCaption("Create");
    c_.Command2.setCaption("Cancel");

    c_.Command1.onClick = [this] { Command1_Click(); };
    c_.Command2.onClick = [this] { Command2_Click(); };
}

void Form_new_list::Form_Load() {
    c_.Text1.setText("");
    c_.Check_info.setValue(1);
    c_.Text1.setFocus();
}

void Form_new_list::Command1_Click() {
    main_.guarded([this] { createList(); });
    // The dialog never stays open after "Create": to try another name the user opens it again.
    c_.window.unload();
}

void Form_new_list::Command2_Click() {
    c_.window.unload();
}

void Form_new_list::createList() {
    const catalogue::EditResult result =
        catalogue::createList(store_, c_.Text1.text(), c_.Check_info.value());
    if (!result) {
        platform_.messageBox(result.refusal, ui::kCritical, "Error");
        return;
    }
    main_.LoadListNames();
}

}  // namespace new_list
