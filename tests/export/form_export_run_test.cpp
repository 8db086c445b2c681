// The export run on in-memory controls, writing real files into a temporary output folder.
#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include <filesystem>

#include "tests/export/export_fixture.h"

namespace {

// "Movies" open with its flag, the dialog open on the output folder, no options set.
struct OpenMovies : export_test::ExportFixture {
    explicit OpenMovies(const std::string& flag = " 0 \r\n") {
        openMovies(flag);
        main.folder.put("export.dat", test_support::crlf({out.path(), "0", "0", "0", "0", "0", "0",
                                                          "10", "Bottom"}));
        openDialog();
    }
    // Presses "Export", answering `boxes` boxes with OK; the boxes shown as "title style: text".
    std::vector<std::string> exportNow(int boxes = 1) {
        const std::size_t before = main.platform.shown().size();
        for (int i = 0; i < boxes; ++i) main.platform.answer(ui::Answer::Ok);
        EXPECT_TRUE(dialog.Command1.click());
        std::vector<std::string> shown;
        for (std::size_t i = before; i < main.platform.shown().size(); ++i) {
            const auto& box = main.platform.shown()[i];
            shown.push_back(box.title + " " + std::to_string(box.style) + ": " + box.prompt);
        }
        return shown;
    }
};

TEST(ExportRun, TextReportThenAReplacedReport) {
    OpenMovies f;
    f.main.folder.put("Movies.top", "Top line one\r\nTop line two");
    f.main.view.List1.setItems(std::vector<std::string>{"Wars", "Star Wars", "Star"});
    f.main.view.List_list.setSelected(0, true);

    EXPECT_EQ(f.exportNow(), std::vector<std::string>{"Done 64: Export done!"});
    EXPECT_EQ(f.out.get("Movies.TXT"), export_test::data("run_movies.txt"));
    EXPECT_EQ(f.dialog.Text1.text(), f.out.path() + "/");
    EXPECT_EQ(f.dialog.Check_noinfo.value(), 1);  // the list's flag 0 wins over the user's box

    // A replaced report keeps the permission bits its owner gave it; this one has the date.
    f.main.folder.put("Movies.top", "Only one line\r\n");
    ::chmod(f.out.file("Movies.TXT").c_str(), 0640);
    f.dialog.Checkdate.userToggle();
    f.exportNow();
    EXPECT_TRUE(f.out.get("Movies.TXT").starts_with("Only one line\r\n.[Movies]"));
    EXPECT_NE(f.out.get("Movies.TXT").find("-06.12.2026-.\r\n"), std::string::npos);
    struct stat st {};
    EXPECT_EQ(::stat(f.out.file("Movies.TXT").c_str(), &st) == 0 ? st.st_mode & 0777 : 0, 0640u);
    EXPECT_EQ(f.out.listing(), "Movies.TXT\n");
}

TEST(ExportRun, TheListsFlagDecidesTheInformationColumn) {
    // Flag 1, or no flag file at all (older lists, as the main window shows them), clears the
    // box; a flag that is neither 0 nor 1 leaves it as it is.
    for (auto [flag, box] :
         {std::pair{" 1 \r\n", 0}, std::pair{" 7 \r\n", 1}, std::pair{"[missing]", 0}}) {
        OpenMovies f(flag);
        if (flag == std::string("[missing]"))
            std::filesystem::remove(f.main.folder.file("Movies.inf"));
        f.dialog.Check_noinfo.setValue(1);
        EXPECT_EQ(f.exportNow(), std::vector<std::string>{"Done 64: Export done!"});
        EXPECT_EQ(f.dialog.Check_noinfo.value(), box) << flag;
        EXPECT_EQ(f.out.get("Movies.TXT").find("| iNFORMATiON      |") != std::string::npos,
                  box == 0)
            << flag;
        // The hidden box keeps nothing from one opening to the next.
        f.dialog.window.userClose();
        f.openDialog();
        EXPECT_EQ(f.dialog.Check_noinfo.value(), 0);
    }
}

// Where the section goes is the builders' and the end-to-end run's; here the refusal.
TEST(ExportRun, TooManyLastAddedAreRefusedAndTheClearedBoxSaved) {
    OpenMovies f;
    f.dialog.Check_lastadd.userToggle();
    // More than the titles: refused, the box cleared, the report written without the section,
    // and the cleared box saved at closing.
    f.dialog.Text2.setText("11");
    EXPECT_EQ(f.exportNow(2),
              (std::vector<std::string>{"ERROR! 16: More last add's than titels!\r\nExport the "
                                        "list without lastadd's",
                                        "Done 64: Export done!"}));
    EXPECT_EQ(f.out.get("Movies.TXT").find("LAST ADDED"), std::string::npos);
    f.dialog.window.userClose();
    EXPECT_EQ(f.main.folder.get("export.dat"),
              test_support::crlf(
                  {f.out.path(), " 0 ", " 0 ", " 0 ", " 0 ", " 0 ", " 0 ", "11", "Bottom"}));
}

// A file that cannot be read is named, and no report is written; keeping an older report that
// cannot be replaced is the atomic write's.
TEST(ExportRun, AFailureNamesTheFileAndWritesNothing) {
    OpenMovies f;
    f.dialog.Checkart.userToggle();
    std::filesystem::remove(f.main.folder.file("Movies.art"));
    const auto shown = f.exportNow();
    ASSERT_EQ(shown.size(), 1u);
    EXPECT_TRUE(shown[0].starts_with("Error 16: The file \"Movies.art\"")) << shown[0];
    EXPECT_EQ(f.out.listing(), "");
}

// The optional top text is left out when it is no file; a FIFO is never waited on.
TEST(ExportRun, ATopTextThatIsAFifoIsLeftOutWithoutWaiting) {
    OpenMovies f;
    ASSERT_EQ(::mkfifo(f.main.folder.file("Movies.top").c_str(), 0644), 0);
    ::alarm(20);  // a blocking open ends the test run here instead of hanging it
    EXPECT_EQ(f.exportNow(), std::vector<std::string>{"Done 64: Export done!"});
    ::alarm(0);
    EXPECT_TRUE(f.out.get("Movies.TXT").starts_with(".[Movies]")) << f.out.get("Movies.TXT");
}

TEST(ExportRun, NoSelectedListOnlyBeeps) {
    OpenMovies f;
    f.main.view.List_list.setSelected(0, false);
    const int beeps = f.main.platform.beeps;
    EXPECT_TRUE(f.exportNow(0).empty());
    EXPECT_EQ(f.main.platform.beeps, beeps + 1);
    EXPECT_EQ(f.out.listing(), "");
}

}  // namespace
