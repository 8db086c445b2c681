#pragma once

#include <string>
#include <vector>

#include "export/form_export.h"
#include "tests/support/memory_dialogs.h"
#include "tests/support/memory_form1.h"
#include "tests/support/temp_folder.h"

// The export dialog on in-memory controls beside the main window, over a temporary catalogue
// folder, with HOME pointing at a folder of its own and an empty output folder.
namespace export_test {

// The bytes of a file of tests/data/export.
std::string data(const std::string& name);

// The titles of the "Movies" test list in the order List1 shows them, all ten or without
// "Casablanca".
std::vector<std::string> movieTitles(bool withCasablanca = true);

// Settings file text from its lines.
std::string settings(const std::vector<std::string>& lines);

class ExportFixture {
  public:
    explicit ExportFixture(std::vector<std::string> drives = {"/"});
    ~ExportFixture();

    // Puts the list "Movies" of tests/data with this flag file, starts the main window and
    // opens the list in it.
    void openMovies(const std::string& flag = " 1 \r\n");
    // The main window's "Export pemla" button.
    void openDialog();

    test_support::TempFolder home;
    test_support::TempFolder out;
    test_support::MainWindowFixture main;
    test_support::MemoryFormExport dialog;
    exporting::Form_Export form;

  private:
    std::string oldHome_;
};

}  // namespace export_test
