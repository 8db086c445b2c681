#pragma once

#include <string>
#include <vector>

#include "export/form_export.h"
#include "tests/support/memory_form1.h"
#include "tests/support/temp_folder.h"
#include "ui/memory/memory_controls.h"

// The export dialog on in-memory controls beside the main window, over a temporary catalogue
// folder, with HOME pointing at a folder of its own and an empty output folder.
namespace export_test {

// The bytes of a file of tests/data/export.
std::string data(const std::string& name);

// The ten titles of the "Movies" test list, in the order List1 shows them.
std::vector<std::string> tenTitles();
// The same without "Casablanca".
std::vector<std::string> nineTitles();

struct MemoryFormExport {
    explicit MemoryFormExport(std::vector<std::string> drives);
    exporting::Form_ExportControls controls();

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

class ExportFixture {
  public:
    explicit ExportFixture(std::vector<std::string> drives = {"/"});
    ~ExportFixture();

    // Puts the list "Movies" (entries and articles from tests/data) with this flag file, starts
    // the main window and opens the list in it.
    void openMovies(const std::string& flag = " 1 \r\n");
    // The main window's "Export pemla" button.
    void openDialog();
    // Settings file text from nine lines.
    static std::string settings(const std::vector<std::string>& lines);

    test_support::TempFolder home;
    test_support::TempFolder out;
    test_support::MainWindowFixture main;
    MemoryFormExport dialog;
    exporting::Form_Export form;

  private:
    std::string oldHome_;
    bool hadHome_ = false;
};

}  // namespace export_test
