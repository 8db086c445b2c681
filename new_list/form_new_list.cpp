#include "new_list/form_new_list.h"

#include <string>

#include "catalogue/file_text.h"
#include "catalogue/records.h"

namespace new_list {

Form_new_list::Form_new_list(const Form_new_listControls& controls, ui::Platform& platform,
                             catalogue::Store& store, main_window::Form1& form1)
    : c_(controls), platform_(platform), store_(store), form1_(form1) {
    c_.window.setCaption(kNewListCaption);
    c_.Label1.setCaption(kNewListPrompt);
    c_.Text1.setMaxLength(kMaxNameLength);
    c_.Check_info.setCaption("Include information column");
    c_.Check_info.setValue(1);
    c_.Command1.setCaption("Create");
    c_.Command2.setCaption("Cancel");

    c_.window.onLoad = [this] { Form_Load(); };
    c_.window.onUnload = [this] { Form_Unload(); };
    c_.Command1.onClick = [this] { Command1_Click(); };
    c_.Command2.onClick = [this] { Command2_Click(); };
}

void Form_new_list::Form_Load() {
    form1_.controls().window.setEnabled(false);
    c_.Text1.setText("");
    c_.Check_info.setValue(1);
    c_.Text1.setFocus();
}

void Form_new_list::Form_Unload() {
    ui::Window& main = form1_.controls().window;
    main.setEnabled(true);
    main.bringToFront();
}

void Form_new_list::Command1_Click() {
    form1_.guarded([this] { createList(); });
    // The dialog never stays open after "Create": to try another name the user opens it again.
    c_.window.unload();
}

void Form_new_list::Command2_Click() {
    c_.window.unload();
}

void Form_new_list::createList() {
    const std::string name = c_.Text1.text();
    const catalogue::NewListCheck check = catalogue::checkNewListName(store_, name);
    if (check.refusal == catalogue::kCatalogueFull)
        throw main_window::Form1::Refusal{check.refusal};
    if (!check.refusal.empty()) {
        platform_.messageBox(check.refusal, 16, "Error");
        return;
    }
    const std::string& index = check.index;

    // The index line and the four files appear together or not at all, so a failure never
    // leaves a listed name without its files.
    catalogue::Transaction change = store_.begin();
    change.write(catalogue::kIndexFile, index + name + "\r\n");
    change.write(catalogue::entryFile(name), catalogue::kSkeletonEntries);
    change.write(catalogue::articleFile(name), catalogue::kSkeletonArticles);
    change.write(catalogue::counterFile(name), catalogue::kSkeletonCounter);
    change.write(catalogue::flagFile(name), catalogue::fileNumber(c_.Check_info.value()));
    change.commit();

    form1_.LoadListNames();
}

}  // namespace new_list
