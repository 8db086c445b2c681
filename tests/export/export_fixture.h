#pragma once

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "tests/support/memory_form1.h"
#include "tests/support/temp_folder.h"

// The export dialog on in-memory controls beside the main window, over a temporary catalogue
// folder, with HOME pointing at a folder of its own and an empty output folder.
namespace export_test {

// The bytes of a file of tests/data/export.
std::string data(const std::string& name);

class ExportFixture {
  public:
    ExportFixture();
    ~ExportFixture();

    // Puts the list "Movies" of tests/data with this flag file, starts the main window and
    // opens the list in it.
    void openMovies(const std::string& flag = " 1 \r\n");
    // The main window's "Export pemla" button.
    void openDialog() { ASSERT_TRUE(main.view.Command_export.click()); }

    test_support::TempFolder home;
    test_support::MainWindowFixture main;
    test_support::MemoryFormExport& dialog = main.exportView;
    const test_support::TempFolder& out = main.out;

  private:
    std::string oldHome_;
};

}  // namespace export_test
