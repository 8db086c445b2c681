#pragma once

#include <gtest/gtest.h>

#include <cstdlib>
#include <fstream>
#include <iterator>
#include <string>

#include "tests/support/memory_form1.h"

// The export dialog on in-memory controls beside the main window, over a temporary catalogue
// folder, with HOME pointing at a folder of its own and an empty output folder.
namespace export_test {

// The bytes of a file of tests/data/export.
inline std::string data(const std::string& name) {
    std::ifstream in(std::string(PEMLA_EXPORT_DATA) + "/" + name, std::ios::binary);
    if (!in) throw std::runtime_error("missing test data " + name);
    return {std::istreambuf_iterator<char>(in), {}};
}

class ExportFixture {
  public:
    ExportFixture() : oldHome_(std::getenv("HOME") ? std::getenv("HOME") : "") {
        ::setenv("HOME", home.path().c_str(), 1);
    }
    ~ExportFixture() { ::setenv("HOME", oldHome_.c_str(), 1); }

    // Puts the list "Movies" of tests/data with this flag file, starts the main window and
    // opens the list in it.
    void openMovies(const std::string& flag = " 1 \r\n") {
        main.folder.putList("Movies", data("movies.dat"), data("movies.art"), "A#003\r\n", flag);
        main.folder.put("pemla.dat", "Movies\r\n");
        main.start();
        main.open("Movies");
    }
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
