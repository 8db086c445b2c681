#pragma once

#include <string>

#include "app/export_view.h"
#include "app/main_window_view.h"
#include "app/new_list_view.h"
#include "app/search_view.h"
#include "catalogue/store.h"
#include "export/form_export.h"
#include "main_window/form1.h"
#include "new_list/form_new_list.h"
#include "search/form_searchart.h"
#include "ui/qt/qt_platform.h"

namespace app {

// The whole program on Qt: the catalogue in one folder, the four windows laid out, and their
// window logic wired together. main() runs it on the working folder; tests run the very same
// windows on a folder of their own.
class Program {
  public:
    // Builds every window; nothing is read or shown until start().
    Program(const std::string& folder, ui::qt::QtPlatform& platform);
    ~Program();
    Program(const Program&) = delete;
    Program& operator=(const Program&) = delete;

    // Shows the main window, whose load handler reads the catalogue. When that fails, the
    // user has been told and platform.ended() is true.
    void start();

    MainWindowView& mainWindow() { return mainView_; }
    NewListView& newListDialog() { return newListView_; }
    SearchView& searchDialog() { return searchView_; }
    ExportView& exportDialog() { return exportView_; }
    main_window::Form1& form1() { return form1_; }
    catalogue::Store& store() { return store_; }

  private:
    // Declared in the order they are built: the dialogs' logic refers to Form1, and Form1
    // refers to the dialogs' windows.
    catalogue::Store store_;
    ui::qt::QtPlatform& platform_;
    MainWindowView mainView_;
    main_window::Form1 form1_;
    main_window::TitleFinder finder_;
    NewListView newListView_;
    new_list::Form_new_list formNewList_;
    SearchView searchView_;
    search::Form_searchart formSearchart_;
    ExportView exportView_;
    exporting::Form_Export formExport_;
};

}  // namespace app
