// The export dialog's opening and closing on in-memory controls: loading, falling back to the
// defaults, drives, and saving on every closing.
#include <gtest/gtest.h>
#include <pwd.h>
#include <unistd.h>

#include <filesystem>

#include "tests/export/export_fixture.h"

namespace {

using export_test::ExportFixture;
using test_support::crlf;

std::string defaultsFor(const std::string& folder) {
    return crlf({folder, "0", "0", "0", "0", "0", "0", "10", "Top"});
}

// What the dialog shows, written as a settings file with plain check values.
std::string shown(ExportFixture& f) {
    std::vector<std::string> lines = {f.dialog.Dir1.path()};
    for (auto* box : {&f.dialog.Checkart, &f.dialog.Checkhtml, &f.dialog.Checkcounter,
                      &f.dialog.Checkdate, &f.dialog.Checkline, &f.dialog.Check_lastadd}) {
        lines.push_back(std::to_string(box->value()));
    }
    lines.push_back(f.dialog.Text2.text());
    lines.push_back(f.dialog.Combo1.text());
    return crlf(lines);
}

TEST(ExportSettingsLoad, NoSettingsWritesTheDefaultsForHomeOrElseTheWorkingFolder) {
    // HOME as the fixture sets it, naming no folder, or unset (the account's home counts then).
    for (const std::string home : {"", "/no/such/home", "unset"}) {
        ExportFixture f;
        home == "unset" ? ::unsetenv("HOME") : home.empty() ? 0 : ::setenv("HOME", home.c_str(), 1);
        f.openMovies();
        f.openDialog();
        EXPECT_EQ(f.dialog.window.caption() + "|" + f.dialog.Label1.caption() + "|" +
                      f.dialog.Label2.caption() + "|" + f.dialog.Label3.caption(),
                  "Export list|Output path:|Amount of last added|Add the last added list in");
        EXPECT_EQ(f.dialog.Text2.maxLength(), 2);
        const passwd* account = ::getpwuid(::getuid());
        std::string folder =
            std::filesystem::absolute(f.main.folder.path()).lexically_normal().string();
        if (home.empty()) folder = f.home.path();
        if (home == "unset" && account != nullptr && std::filesystem::is_directory(account->pw_dir))
            folder = account->pw_dir;
        EXPECT_EQ(f.main.folder.get("export.dat") + shown(f),
                  defaultsFor(folder) + defaultsFor(folder));
    }
}

TEST(ExportSettingsLoad, EachValueLoadsAsItIsOrAloneFallsBackToItsDefault) {
    using Lines = std::vector<std::string>;
    const std::pair<Lines, Lines> cases[] = {
        // the file, and what the dialog shows ("~" stands for the home folder)
        {{"/", " 1 ", "1", " 0 ", "3", "2", "", "ab", "Bottom"},
         {"/", "1", "1", "0", "0", "2", "0", "ab", "Bottom"}},
        {{"/", " 1 ", " 1 ", " 0 "}, {"/", "1", "1", "0", "0", "0", "0", "10", "Top"}},
        {{"/no/such/folder", "1", "0", "1", "1", "1", "1", "5", "Middle"},
         {"~", "1", "0", "1", "1", "1", "1", "5", "Top"}},
        {{"relative/folder", "1", "1", "1", "1", "1", "1", "\"\"\"5\"", "Top"},
         {"~", "1", "1", "1", "1", "1", "1", "\"5", "Top"}},
        {{"\"/open", "1", "1", "1", "1", "1", "1", "5", "Top"},
         {"~", "1", "1", "1", "1", "1", "1", "5", "Top"}},
    };
    for (auto [file, expected] : cases) {
        ExportFixture f;
        f.openMovies();
        f.main.folder.put("export.dat", crlf(file));
        f.openDialog();
        SCOPED_TRACE(file[0] + " / " + file.back());
        if (expected[0] == "~") expected[0] = f.home.path();
        EXPECT_EQ(shown(f), crlf(expected));
        EXPECT_EQ(f.main.folder.get("export.dat"), crlf(file));  // nothing replaced on load
    }
}

TEST(ExportSettingsLoad, TheDriveIsTheVolumeHoldingTheFolder) {
    // The test folders live in the temporary folder, here taken as a volume of its own.
    const std::string volume = std::filesystem::temp_directory_path().string();
    ExportFixture f;
    f.dialog.Drive1.offer({"/", "/no-such-volume", volume});
    const std::string sub = f.out.file("sub");
    std::filesystem::create_directory(sub);
    f.openMovies();
    f.main.folder.put("export.dat", defaultsFor(sub));
    f.openDialog();
    EXPECT_EQ(f.dialog.Drive1.drive(), volume);
    EXPECT_EQ(f.dialog.Dir1.path(), sub);

    // Choosing a drive shows its root; one that cannot be read is refused with a beep.
    ASSERT_TRUE(f.dialog.Drive1.setDrive("/"));
    EXPECT_EQ(f.dialog.Dir1.path(), "/");
    ASSERT_TRUE(f.dialog.Dir1.setPath(f.out.path()));
    const int beeps = f.main.platform.beeps;
    ASSERT_TRUE(f.dialog.Drive1.setDrive("/no-such-volume"));
    EXPECT_EQ(f.main.platform.beeps, beeps + 1);
    EXPECT_EQ(f.dialog.Dir1.path(), f.out.path());
    EXPECT_EQ(f.dialog.Drive1.drive(), volume);
}

// Closing the main window closes the dialog, which saves what it shows; the folder is quoted.
// Its own buttons and close box save the same way (the end-to-end run and the Qt dialog's test).
TEST(ExportSettingsSave, ClosingTheMainWindowSavesAFolderWithAComma) {
    ExportFixture f;
    const std::string folder = f.out.file("a, b");
    std::filesystem::create_directory(folder);
    f.openMovies();
    f.openDialog();
    ASSERT_TRUE(f.dialog.Dir1.setPath(folder));
    f.dialog.Text2.setText("");
    ASSERT_TRUE(f.dialog.Combo1.userPick(1));
    f.dialog.Checkdate.userToggle();
    f.main.view.window.userClose();
    EXPECT_FALSE(f.dialog.window.isLoaded());
    EXPECT_EQ(f.main.folder.get("export.dat"),
              crlf({'"' + folder + '"', " 0 ", " 0 ", " 0 ", " 1 ", " 0 ", " 0 ", "", "Bottom"}));
}

}  // namespace
