#pragma once

#include <string>
#include <string_view>

#include "catalogue/store.h"
#include "export/export_settings.h"
#include "main_window/main_window_link.h"
#include "ui/controls.h"
#include "ui/platform.h"

// The export dialog: output folder, report options, and the export run itself.
namespace exporting {

struct Form_ExportControls {
    ui::Window& window;           // the dialog
    ui::Label& Label1;            // "Output path:" caption
    ui::DirList& Dir1;            // output folder
    ui::DriveList& Drive1;        // drive of the output folder
    ui::Button& Command1;         // Export
    ui::Button& Command2;         // Cancel
    ui::CheckBox& Checkart;       // include article numbers
    ui::CheckBox& Checkhtml;      // save as HTML
    ui::CheckBox& Checkcounter;   // include counter
    ui::CheckBox& Checkdate;      // include date
    ui::CheckBox& Checkline;      // separator lines
    ui::CheckBox& Check_lastadd;  // include the last added
    ui::Label& Label2;            // "Amount of last added" caption
    ui::TextBox& Text2;           // amount of last added
    ui::Label& Label3;            // caption of the placement choice
    ui::ComboBox& Combo1;         // last added at Top or Bottom (pick-only)
    ui::CheckBox& Check_noinfo;   // leave out the information column
    ui::TextBox& Text1;           // folder the last report went to
};

inline constexpr const char* kForm_ExportCaption = "Export list";
// The last line of every report: 36 spaces and this text of 41 characters.
inline constexpr std::string_view kCreditText = "Exported from the disc catalogue, v. 0.90";
static_assert(kCreditText.size() == 41);

class Form_Export : public main_window::MainWindowDialog {
  public:
    // Sets the captions and initial texts and wires every event to its handler.
    Form_Export(const Form_ExportControls& controls, ui::Platform& platform,
                catalogue::Store& store, main_window::MainWindowLink& main);

    const Form_ExportControls& controls() const { return c_; }

    // Opening: the settings are loaded.
    void Form_Load() override;
    // Every closing saves the settings.
    void Form_Unload() override;
    // "Export".
    void Command1_Click() { RunExport(); }
    // "Cancel" closes the dialog, which saves the settings.
    void Command2_Click() { c_.window.unload(); }
    // A drive chosen (by the user or by loading) shows its root in Dir1. A drive that cannot be
    // read is refused with a beep, and the drive of the current folder is chosen again.
    void Drive1_Change();

    // Builds the report of the list selected in the main window from its files and the options,
    // and writes it as list name + ".TXT" or ".html" into Dir1's folder, atomically. A missing
    // list file or a failed write is shown as a message naming the file; the dialog stays usable
    // and an older report stays as it was. Without a selected list it only beeps.
    void RunExport();

    // Loads "export.dat" into the controls. A value that cannot be used gets its default (for the
    // folder: the home folder, else the working folder) and the others stay; a missing file is
    // written with the defaults. It never reports.
    void LoadSettings();
    // Writes the controls' settings to "export.dat". Throws CatalogueError.
    void SaveSettings();

    // The bytes of a list's report file as RunExport writes it: the text, or the HTML page.
    // Sets Check_noinfo from the list's flag; may clear Check_lastadd and show its refusal.
    // Throws CatalogueError when a list file is missing or unreadable.
    std::string BuildReport(const std::string& list);

  private:
    // Shows `folder` (file-system bytes) in Drive1 and Dir1; false when it cannot be shown.
    bool applyFolder(const std::string& folder);
    std::string workingFolder() const;

    Form_ExportControls c_;
    ui::Platform& platform_;
    catalogue::Store& store_;
    bool loading_ = false;
    bool restoringDrive_ = false;
};

}  // namespace exporting
