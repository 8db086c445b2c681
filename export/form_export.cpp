#include "export/form_export.h"

#include <filesystem>
#include <vector>

#include "catalogue/catalogue_error.h"
#include "catalogue/file_names.h"
#include "export/last_added.h"
#include "export/list_report.h"

namespace exporting {

using catalogue::CatalogueError;

namespace {

// Enables the dialog again however the run ends.
class DisabledWhileRunning {
  public:
    explicit DisabledWhileRunning(ui::Window& window) : window_(window) {
        window_.setEnabled(false);
    }
    ~DisabledWhileRunning() { window_.setEnabled(true); }
    DisabledWhileRunning(const DisabledWhileRunning&) = delete;
    DisabledWhileRunning& operator=(const DisabledWhileRunning&) = delete;

  private:
    ui::Window& window_;
};

// The path used to find a folder's volume: links resolved where they exist.
std::string resolved(const std::string& folder) {
    std::error_code ec;
    const std::filesystem::path real = std::filesystem::weakly_canonical(folder, ec);
    return ec ? folder : real.string();
}

}  // namespace

Form_Export::Form_Export(const Form_ExportControls& controls, ui::Platform& platform,
                         catalogue::Store& store, main_window::MainWindowLink& main)
    : MainWindowDialog(controls.window, main), c_(controls), platform_(platform), store_(store) {
    c_.window.setCaption(kForm_ExportCaption);
    c_.Label1.setCaption("Output path:");
    c_.Command1.setCaption("Export");
    c_.Command2.setCaption("Cancel");
    c_.Checkart.setCaption("Include Article number");
    c_.Checkhtml.setCaption("Save as HTML");
    c_.Checkcounter.setCaption("Include counter");
    c_.Checkdate.setCaption("Include date");
    c_.Checkline.setCaption("Separate line");
    c_.Check_lastadd.setCaption("Include last added on the list");
    c_.Label2.setCaption("Amount of last added");
    c_.Text2.setMaxLength(2);
    c_.Text2.setText("10");
    c_.Label3.setCaption("Add the last added list in");
    c_.Combo1.setItems({"Top", "Bottom"});
    c_.Check_noinfo.setCaption("Don't include information");

    c_.Command1.onClick = [this] { Command1_Click(); };
    c_.Command2.onClick = [this] { Command2_Click(); };
    c_.Drive1.onChange = [this] { Drive1_Change(); };
}

void Form_Export::Form_Load() {
    // The hidden box follows the list of each run; it starts cleared at every opening.
    c_.Check_noinfo.setValue(0);
    LoadSettings();
}

void Form_Export::Form_Unload() {
    main_.guarded([this] { SaveSettings(); });
}

void Form_Export::Drive1_Change() {
    if (restoringDrive_) return;
    if (c_.Dir1.setPath(c_.Drive1.drive()) || loading_) return;
    // An unreadable drive (no medium, no permission): stay where the folder list is.
    platform_.beep();
    restoringDrive_ = true;
    c_.Drive1.setDrive(driveOf(c_.Drive1.drives(), resolved(c_.Dir1.path())));
    restoringDrive_ = false;
}

std::string Form_Export::workingFolder() const {
    std::error_code ec;
    const std::filesystem::path folder = std::filesystem::absolute(store_.folder(), ec);
    return ec ? store_.folder() : folder.lexically_normal().string();
}

void Form_Export::LoadSettings() {
    std::optional<ExportSettings> stored;
    try {
        if (store_.exists(kSettingsFile)) stored = decodeSettings(store_.readBytes(kSettingsFile));
    } catch (const CatalogueError&) {
    }
    ExportSettings settings = stored.value_or(ExportSettings{});
    // A value that cannot be used costs only itself: the folder falls back to the home folder,
    // else the working folder, and the other values keep what was read.
    if (!applyFolder(settings.folder)) {
        std::vector<std::string> defaults;
        if (const std::string home = homeFolder(); !home.empty()) defaults.push_back(home);
        defaults.push_back(workingFolder());
        for (const std::string& folder : defaults) {
            if (applyFolder(folder)) break;
        }
    }
    ui::CheckBox* boxes[] = {&c_.Checkart,  &c_.Checkhtml, &c_.Checkcounter,
                             &c_.Checkdate, &c_.Checkline, &c_.Check_lastadd};
    for (std::size_t i = 0; i < settings.checks.size(); ++i) boxes[i]->setValue(settings.checks[i]);
    c_.Text2.setText(settings.amount);
    if (!c_.Combo1.setText(settings.position)) c_.Combo1.setText(ExportSettings{}.position);
    if (stored) return;
    try {
        catalogue::Transaction t = store_.begin();
        t.write(kSettingsFile, defaultSettingsText(c_.Dir1.path()));
        t.commit();
    } catch (const CatalogueError&) {
        // The file cannot be written here: the defaults stay in the controls all the same.
    }
}

bool Form_Export::applyFolder(const std::string& folder) {
    if (!folder.starts_with('/')) return false;
    const std::string drive = driveOf(c_.Drive1.drives(), resolved(folder));
    if (drive.empty()) return false;
    loading_ = true;
    const bool driveSet = c_.Drive1.setDrive(drive);
    loading_ = false;
    return driveSet && c_.Dir1.setPath(folder);
}

void Form_Export::SaveSettings() {
    ExportSettings settings;
    settings.folder = c_.Dir1.path();
    settings.checks = {c_.Checkart.value(),  c_.Checkhtml.value(), c_.Checkcounter.value(),
                       c_.Checkdate.value(), c_.Checkline.value(), c_.Check_lastadd.value()};
    settings.amount = c_.Text2.text();
    settings.position = c_.Combo1.text();
    catalogue::Transaction t = store_.begin();
    t.write(kSettingsFile, encodeSettings(settings));
    t.commit();
}

std::string Form_Export::BuildReport(const std::string& list) {
    const ui::ListBox& titlesBox = main_.titles();
    // Views of the box's own items: the box does not change while the report is built.
    std::vector<std::string_view> titles;
    titles.reserve(static_cast<std::size_t>(titlesBox.count()));
    for (int i = 0; i < titlesBox.count(); ++i) titles.push_back(titlesBox.itemText(i));

    ReportChoices choices;
    choices.articleNumbers = c_.Checkart.value() == 1;
    choices.counter = c_.Checkcounter.value() == 1;
    choices.date = c_.Checkdate.value() == 1;
    choices.separatorLines = c_.Checkline.value() == 1;
    choices.noInformation = c_.Check_noinfo.value() == 1;
    choices.lastAdded = c_.Check_lastadd.value() == 1;
    choices.amountText = c_.Text2.text();
    choices.position = c_.Combo1.text();
    choices.html = c_.Checkhtml.value() == 1;
    const std::string date = choices.date ? platform_.shortDate() : std::string();
    ListReport report = buildListReport(store_, list, titles, choices, date);
    if (report.flag == 1) c_.Check_noinfo.setValue(0);
    if (report.flag == 0) c_.Check_noinfo.setValue(1);
    if (report.lastAddedRefused) {
        c_.Check_lastadd.setValue(0);
        platform_.messageBox(kTooManyLastAdded, ui::kCritical, kTooManyLastAddedTitle);
    }
    return std::move(report.text);
}

void Form_Export::RunExport() {
    {
        const DisabledWhileRunning disabled(c_.window);
        const std::string list = main_.selectedList();
        if (list.empty()) {
            platform_.beep();
            return;
        }
        try {
            std::string report = BuildReport(list);
            std::string folder = c_.Dir1.path();
            if (!folder.ends_with('/')) folder.push_back('/');
            c_.Text1.setText(folder);
            // The folder is the file system's bytes; the list name is converted to match them.
            const std::string out = folder + catalogue::fileSystemName(list);
            store_.writeReport(out + (c_.Checkhtml.value() == 1 ? ".html" : ".TXT"), report);
        } catch (const CatalogueError& error) {
            c_.window.setEnabled(true);
            main_.showError(error.file(), error.reason());
            return;
        }
    }
    platform_.messageBox("Export done!", ui::kInformation, "Done");
}

}  // namespace exporting
