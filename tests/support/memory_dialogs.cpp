#include "tests/support/memory_dialogs.h"

namespace test_support {

MemoryNewList::MemoryNewList() {
    for (ui::memory::Owned* control :
         std::initializer_list<ui::memory::Owned*>{&Text1, &Check_info, &Command1, &Command2}) {
        control->setOwner(&window);
    }
}

new_list::Form_new_listControls MemoryNewList::controls() {
    return {window, Label1, Text1, Check_info, Command1, Command2};
}

MemoryFormExport::MemoryFormExport(std::vector<std::string> drives) : Drive1(std::move(drives)) {
    for (ui::memory::Owned* control : std::initializer_list<ui::memory::Owned*>{
             &Dir1, &Drive1, &Command1, &Command2, &Checkart, &Checkhtml, &Checkcounter, &Checkdate,
             &Checkline, &Check_lastadd, &Text2, &Combo1, &Check_noinfo, &Text1}) {
        control->setOwner(&window);
    }
}

exporting::Form_ExportControls MemoryFormExport::controls() {
    return {window,   Label1,    Dir1,         Drive1,    Command1,     Command2,
            Checkart, Checkhtml, Checkcounter, Checkdate, Checkline,    Check_lastadd,
            Label2,   Text2,     Label3,       Combo1,    Check_noinfo, Text1};
}

}  // namespace test_support
