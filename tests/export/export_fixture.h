#pragma once

#include <string>
#include <vector>

#include "export/form_export.h"
#include "tests/support/memory_dialogs.h"
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

using test_support::MemoryFormExport;

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
