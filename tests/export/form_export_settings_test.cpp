// The export dialog's opening and closing on in-memory controls: loading, falling back to the
// defaults, drives, and saving on every closing.
#include <gtest/gtest.h>
#include <sys/stat.h>

#include <filesystem>

#include "tests/export/export_fixture.h"

namespace {

using export_test::ExportFixture;
using ui::Answer;

std::string defaultsFor(const std::string& folder) {
    return folder + "\r\n0\r\n0\r\n0\r\n0\r\n0\r\n0\r\n10\r\nTop\r\n";
}

void expectDefaults(ExportFixture& f, const std::string& folder) {
    EXPECT_EQ(f.main.folder.get("export.dat"), defaultsFor(folder));
    EXPECT_EQ(f.dialog.Dir1.path(), folder);
    for (auto* box : {&f.dialog.Checkart, &f.dialog.Checkhtml, &f.dialog.Checkcounter,
                      &f.dialog.Checkdate, &f.dialog.Checkline, &f.dialog.Check_lastadd}) {
        EXPECT_EQ(box->value(), 0);
    }
    EXPECT_EQ(f.dialog.Text2.text(), "10");
    EXPECT_EQ(f.dialog.Combo1.text(), "Top");
}

TEST(ExportSettingsLoad, OpeningWithoutSettingsWritesAndShowsTheDefaults) {
    ExportFixture f;
    f.openMovies();
    f.openDialog();
    EXPECT_TRUE(f.dialog.window.isLoaded());
    EXPECT_EQ(f.dialog.window.caption(), "Export list");
    EXPECT_EQ(f.dialog.Text2.maxLength(), 2);
    EXPECT_FALSE(f.main.view.window.isEnabled());
    expectDefaults(f, f.home.path());
}

TEST(ExportSettingsLoad, BrokenSettingsAreReplacedByTheDefaults) {
    const std::vector<std::string> broken[] = {
        {"/", " 1 ", " 1 ", " 0 "},                                              // partial file
        {"/no/such/folder/anywhere", "1", "1", "1", "1", "1", "1", "5", "Top"},  // vanished
        {"/", "1", "1", "3", "1", "1", "1", "5", "Top"},     // not a check value
        {"/", "1", "1", "1", "1", "1", "1", "5", "Middle"},  // not a position
        {"relative/folder", "1", "1", "1", "1", "1", "1", "5", "Top"},
    };
    for (const auto& lines : broken) {
        ExportFixture f;
        f.openMovies();
        f.main.folder.put("export.dat", ExportFixture::settings(lines));
        f.openDialog();
        SCOPED_TRACE(lines[0] + " / " + lines.back());
        expectDefaults(f, f.home.path());
    }
}

TEST(ExportSettingsLoad, CheckValuesLoadWithOrWithoutSpaces) {
    ExportFixture f;
    f.openMovies();
    f.main.folder.put("export.dat", ExportFixture::settings({f.out.path(), " 1 ", "1", " 0 ", "0",
                                                             "2", "", "ab", "Bottom"}));
    f.openDialog();
    EXPECT_EQ(f.dialog.Dir1.path(), f.out.path());
    EXPECT_EQ(f.dialog.Checkart.value(), 1);
    EXPECT_EQ(f.dialog.Checkhtml.value(), 1);
    EXPECT_EQ(f.dialog.Checkcounter.value(), 0);
    EXPECT_EQ(f.dialog.Checkdate.value(), 0);
    EXPECT_EQ(f.dialog.Checkline.value(), 2);
    EXPECT_EQ(f.dialog.Check_lastadd.value(), 0);
    EXPECT_EQ(f.dialog.Text2.text(), "ab");
    EXPECT_EQ(f.dialog.Combo1.text(), "Bottom");
    // Loading replaced nothing.
    EXPECT_EQ(
        f.main.folder.get("export.dat"),
        ExportFixture::settings({f.out.path(), " 1 ", "1", " 0 ", "0", "2", "", "ab", "Bottom"}));
}

TEST(ExportSettingsLoad, UnusableHomeFallsBackToTheWorkingFolderWithoutLooping) {
    ExportFixture f;
    ::setenv("HOME", "/no/such/home", 1);
    f.openMovies();
    f.openDialog();
    const std::string working =
        std::filesystem::absolute(f.main.folder.path()).lexically_normal().string();
    expectDefaults(f, working);
}

TEST(ExportSettingsLoad, SettingsThatCannotBeStoredStillOpenWithTheDefaults) {
    ExportFixture f;
    f.openMovies();
    std::filesystem::create_directory(f.main.folder.file("export.dat"));
    f.openDialog();
    EXPECT_EQ(f.dialog.Dir1.path(), f.home.path());
    EXPECT_EQ(f.dialog.Text2.text(), "10");
    EXPECT_EQ(f.dialog.Combo1.text(), "Top");
    EXPECT_TRUE(f.main.platform.shown().empty());  // loading never reports

    // Saving does report, and the main window is given back all the same.
    f.main.platform.answer(Answer::Ok);
    f.dialog.Command2.click();
    ASSERT_EQ(f.main.platform.shown().size(), 1u);
    EXPECT_NE(f.main.platform.shown()[0].prompt.find("export.dat"), std::string::npos);
    EXPECT_TRUE(f.main.view.window.isEnabled());
}

TEST(ExportSettingsLoad, TheDriveIsTheVolumeHoldingTheFolder) {
    // The test folders live in the temporary folder, here taken as a volume of its own.
    const std::string volume = std::filesystem::temp_directory_path().string();
    ExportFixture f({"/", "/no-such-volume", volume});
    std::filesystem::create_directory(f.out.file("sub"));
    f.openMovies();
    f.main.folder.put("export.dat", ExportFixture::settings({f.out.file("sub"), "0", "0", "0", "0",
                                                             "0", "0", "10", "Top"}));
    f.openDialog();
    EXPECT_EQ(f.dialog.Drive1.drive(), volume);
    EXPECT_EQ(f.dialog.Dir1.path(), f.out.file("sub"));

    // Choosing a drive shows its root; one that cannot be read is refused with a beep.
    ASSERT_TRUE(f.dialog.Drive1.setDrive("/"));
    EXPECT_EQ(f.dialog.Dir1.path(), "/");
    ASSERT_TRUE(f.dialog.Dir1.setPath(f.out.path()));
    const int beeps = f.main.platform.beeps();
    ASSERT_TRUE(f.dialog.Drive1.setDrive("/no-such-volume"));
    EXPECT_EQ(f.main.platform.beeps(), beeps + 1);
    EXPECT_EQ(f.dialog.Dir1.path(), f.out.path());
    EXPECT_EQ(f.dialog.Drive1.drive(), volume);
}

TEST(ExportSettingsSave, EveryClosingSavesButExitDoesNot) {
    ExportFixture f;
    f.openMovies();

    // "Cancel".
    f.openDialog();
    f.dialog.Dir1.setPath(f.out.path());
    f.dialog.Checkart.userToggle();
    f.dialog.Text2.setText("");
    ASSERT_TRUE(f.dialog.Combo1.userPick(1));
    ASSERT_TRUE(f.dialog.Command2.click());
    EXPECT_FALSE(f.dialog.window.isLoaded());
    EXPECT_TRUE(f.main.view.window.isEnabled());
    EXPECT_GE(f.main.view.window.frontCount(), 1);
    const std::string saved = ExportFixture::settings(
        {f.out.path(), " 1 ", " 0 ", " 0 ", " 0 ", " 0 ", " 0 ", "", "Bottom"});
    EXPECT_EQ(f.main.folder.get("export.dat"), saved);

    // The close box: reopening shows what was saved, and closing saves the change.
    f.openDialog();
    EXPECT_EQ(f.dialog.Checkart.value(), 1);
    EXPECT_EQ(f.dialog.Text2.text(), "");
    f.dialog.Checkdate.userToggle();
    f.dialog.window.userClose();
    EXPECT_TRUE(f.main.view.window.isEnabled());
    EXPECT_EQ(f.main.folder.get("export.dat"),
              ExportFixture::settings(
                  {f.out.path(), " 1 ", " 0 ", " 0 ", " 1 ", " 0 ", " 0 ", "", "Bottom"}));

    // The main window closing unloads the dialog, which saves.
    f.openDialog();
    f.dialog.Checkline.userToggle();
    f.main.view.window.userClose();
    EXPECT_FALSE(f.dialog.window.isLoaded());
    EXPECT_NE(f.main.folder.get("export.dat").find(" 1 \r\n 0 \r\n\r\nBottom"), std::string::npos);

    // "Exit" ends the program without saving.
    ExportFixture g;
    g.openMovies();
    g.openDialog();
    const std::string before = g.main.folder.get("export.dat");
    g.dialog.Checkhtml.userToggle();
    g.main.form->Command_print_Click();
    EXPECT_TRUE(g.main.platform.ended());
    EXPECT_EQ(g.main.folder.get("export.dat"), before);
}

TEST(ExportSettingsSave, FolderWithACommaSurvivesSavingAndLoading) {
    ExportFixture f;
    const std::string folder = f.out.file("a, b");
    std::filesystem::create_directory(folder);
    f.openMovies();
    f.openDialog();
    ASSERT_TRUE(f.dialog.Dir1.setPath(folder));
    f.dialog.Command2.click();
    EXPECT_TRUE(f.main.folder.get("export.dat").starts_with("\"" + folder + "\"\r\n"));
    f.openDialog();
    EXPECT_EQ(f.dialog.Dir1.path(), folder);

    // The same folder written unquoted, as an older file would hold it, is cut at the comma.
    f.dialog.Command2.click();
    f.main.folder.put("export.dat",
                      ExportFixture::settings({folder, "1", "1", "1", "1", "1", "1", "10", "Top"}));
    f.openDialog();
    expectDefaults(f, f.home.path());
}

TEST(ExportSettingsSave, LastAddedClearedByTheExportIsSavedCleared) {
    ExportFixture f;
    f.openMovies();
    f.main.folder.put("export.dat", ExportFixture::settings(
                                        {f.out.path(), "0", "0", "0", "0", "0", "1", "11", "Top"}));
    f.openDialog();
    ASSERT_EQ(f.dialog.Check_lastadd.value(), 1);
    f.main.platform.answer(Answer::Ok);  // too many last added
    f.main.platform.answer(Answer::Ok);  // done
    ASSERT_TRUE(f.dialog.Command1.click());
    ASSERT_EQ(f.main.platform.shown().size(), 2u);
    EXPECT_EQ(f.main.platform.shown()[0].prompt,
              "More last add's than titels!\r\nExport the list without lastadd's");
    EXPECT_EQ(f.main.platform.shown()[0].title, "ERROR!");
    EXPECT_EQ(f.main.platform.shown()[0].style, 16);
    EXPECT_EQ(f.dialog.Check_lastadd.value(), 0);
    EXPECT_EQ(f.out.get("Movies.TXT").find("LAST ADDED"), std::string::npos);
    f.dialog.window.userClose();
    EXPECT_EQ(f.main.folder.get("export.dat"),
              ExportFixture::settings(
                  {f.out.path(), " 0 ", " 0 ", " 0 ", " 0 ", " 0 ", " 0 ", "11", "Top"}));
}

}  // namespace
