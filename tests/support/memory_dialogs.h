#pragma once

#include "export/form_export.h"
#include "new_list/form_new_list.h"
#include "tests/support/memory/memory_controls.h"

namespace test_support {

// The new-list dialog's controls in memory, each owned by the dialog's window.
struct MemoryNewList {
    MemoryNewList() { ui::memory::own(window, Text1, Check_info, Command1, Command2); }
    new_list::Form_new_listControls controls() {
        return {window, Label1, Text1, Check_info, Command1, Command2};
    }

    ui::memory::MemoryWindow window;
    ui::memory::MemoryLabel Label1;
    ui::memory::MemoryTextBox Text1;
    ui::memory::MemoryCheckBox Check_info;
    ui::memory::MemoryButton Command1;
    ui::memory::MemoryButton Command2;
};

// The export dialog's controls in memory, each owned by the dialog's window; "/" is the only
// volume until the test offers others.
struct MemoryFormExport {
    MemoryFormExport() {
        ui::memory::own(window, Dir1, Drive1, Command1, Command2, Checkart, Checkhtml, Checkcounter,
                        Checkdate, Checkline, Check_lastadd, Text2, Combo1, Check_noinfo, Text1);
    }
    exporting::Form_ExportControls controls() {
        return {window,   Label1,    Dir1,         Drive1,    Command1,     Command2,
                Checkart, Checkhtml, Checkcounter, Checkdate, Checkline,    Check_lastadd,
                Label2,   Text2,     Label3,       Combo1,    Check_noinfo, Text1};
    }

    ui::memory::MemoryWindow window;
    ui::memory::MemoryLabel Label1;
    ui::memory::MemoryDirList Dir1;
    ui::memory::MemoryDriveList Drive1;
    ui::memory::MemoryButton Command1;
    ui::memory::MemoryButton Command2;
    ui::memory::MemoryCheckBox Checkart;
    ui::memory::MemoryCheckBox Checkhtml;
    ui::memory::MemoryCheckBox Checkcounter;
    ui::memory::MemoryCheckBox Checkdate;
    ui::memory::MemoryCheckBox Checkline;
    ui::memory::MemoryCheckBox Check_lastadd;
    ui::memory::MemoryLabel Label2;
    ui::memory::MemoryTextBox Text2;
    ui::memory::MemoryLabel Label3;
    ui::memory::MemoryComboBox Combo1{true};
    ui::memory::MemoryCheckBox Check_noinfo;
    ui::memory::MemoryTextBox Text1;
};

}  // namespace test_support
