#include "tests/support/memory_dialogs.h"

namespace test_support {

MemoryNewList::MemoryNewList() {
    ui::memory::own(window, Text1, Check_info, Command1, Command2);
}

new_list::Form_new_listControls MemoryNewList::controls() {
    return {window, Label1, Text1, Check_info, Command1, Command2};
}

MemoryFormExport::MemoryFormExport() {
    ui::memory::own(window, Dir1, Drive1, Command1, Command2, Checkart, Checkhtml, Checkcounter,
                    Checkdate, Checkline, Check_lastadd, Text2, Combo1, Check_noinfo, Text1);
}

exporting::Form_ExportControls MemoryFormExport::controls() {
    return {window,   Label1,    Dir1,         Drive1,    Command1,     Command2,
            Checkart, Checkhtml, Checkcounter, Checkdate, Checkline,    Check_lastadd,
            Label2,   Text2,     Label3,       Combo1,    Check_noinfo, Text1};
}

}  // namespace test_support
