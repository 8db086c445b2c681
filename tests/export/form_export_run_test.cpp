// The export run on in-memory controls, writing real files into a temporary output folder.
#include <gtest/gtest.h>
#include <sys/stat.h>

#include <filesystem>

#include "tests/export/export_fixture.h"

namespace {

using export_test::data;
using export_test::ExportFixture;
using ui::Answer;

// A fixture with "Movies" open, the dialog open on the output folder, no options set.
struct OpenMovies : ExportFixture {
    explicit OpenMovies(const std::string& flag = " 0 \r\n") {
        openMovies(flag);
        main.folder.put("export.dat",
                        settings({out.path(), "0", "0", "0", "0", "0", "0", "10", "Bottom"}));
        openDialog();
    }
    // Presses "Export", answering every box with OK; the prompts shown.
    std::vector<std::string> exportNow(int boxes = 1) {
        const std::size_t before = main.platform.shown().size();
        for (int i = 0; i < boxes; ++i) main.platform.answer(Answer::Ok);
        EXPECT_TRUE(dialog.Command1.click());
        std::vector<std::string> prompts;
        for (std::size_t i = before; i < main.platform.shown().size(); ++i) {
            prompts.push_back(main.platform.shown()[i].title + ": " +
                              main.platform.shown()[i].prompt);
        }
        return prompts;
    }
};

TEST(ExportRun, WritesTheTextReportWithTopTextAndCreditLine) {
    OpenMovies f;
    f.main.folder.put("Movies.top", "Top line one\r\nTop line two");
    f.main.view.List1.setItems({"Wars", "Star Wars", "Star"});
    f.main.view.List_list.setSelected(0, true);
    EXPECT_EQ(f.dialog.Check_noinfo.value(), 0);

    EXPECT_EQ(f.exportNow(), std::vector<std::string>{"Done: Export done!"});
    EXPECT_EQ(f.main.platform.shown().back().style, 64);
    EXPECT_EQ(f.out.get("Movies.TXT"), data("run_movies.txt"));
    EXPECT_EQ(f.dialog.Text1.text(), f.out.path() + "/");
    EXPECT_EQ(f.dialog.Check_noinfo.value(), 1);  // the list's flag 0 wins over the user's box
    EXPECT_TRUE(f.dialog.window.isEnabled());
    EXPECT_TRUE(f.dialog.window.isLoaded());

    // A second export replaces the first and leaves nothing else behind.
    f.main.folder.put("Movies.top", "Only one line\r\n");
    f.exportNow();
    EXPECT_TRUE(f.out.get("Movies.TXT").starts_with("Only one line\r\n.[Movies]"));
    EXPECT_EQ(f.out.listing(), "Movies.TXT\n");
}

TEST(ExportRun, TheListsFlagDecidesTheInformationColumn) {
    OpenMovies f(" 1 \r\n");
    f.dialog.Check_noinfo.setValue(1);
    f.exportNow();
    EXPECT_EQ(f.dialog.Check_noinfo.value(), 0);
    EXPECT_NE(f.out.get("Movies.TXT").find("| iNFORMATiON      |"), std::string::npos);

    // A flag that is neither 0 nor 1 leaves the box as it is.
    f.main.folder.put("Movies.inf", " 7 \r\n");
    f.dialog.Check_noinfo.setValue(1);
    f.exportNow();
    EXPECT_EQ(f.dialog.Check_noinfo.value(), 1);
    EXPECT_EQ(f.out.get("Movies.TXT").find("iNFORMATiON"), std::string::npos);
}

TEST(ExportRun, HtmlPageInsteadOfTheTextFile) {
    OpenMovies f;
    f.main.view.List1.setItems({"Wars", "Star Wars", "Star"});
    f.main.view.List_list.setSelected(0, true);
    f.main.folder.put("Movies.top", "Top line one\r\nTop line two\r\n");
    f.dialog.Checkhtml.userToggle();
    f.exportNow();
    EXPECT_FALSE(f.out.has("Movies.TXT"));
    const std::string page = f.out.get("Movies.html");
    std::string report = data("run_movies.txt");
    report.resize(report.size() - 2);  // the text file's extra CR LF is not part of the report
    // Ten report lines and eleven of the page.
    std::size_t lines = 0;
    for (std::size_t at = page.find("\r\n"); at != std::string::npos;
         at = page.find("\r\n", at + 1)) {
        ++lines;
    }
    EXPECT_EQ(lines, 10u + 11);
    EXPECT_TRUE(page.starts_with("<html>\r\n<head>\r\n<title>Movies</title>\r\n")) << page;
    EXPECT_NE(page.find("<pre>\r\nTop line one\r\nTop line two\r\n.[Movies]"), std::string::npos);
    EXPECT_NE(
        page.find("\r\n&gt;-----------------------------------------------+-------------------"
                  "+--------&lt;\r\n"),
        std::string::npos);
    EXPECT_TRUE(page.ends_with("v. 0.90\r\n\r\n</pre>\r\n</body>\r\n</html>\r\n"));
}

TEST(ExportRun, LastAddedSectionAboveOrBelowEverything) {
    OpenMovies f;
    f.main.folder.put("Movies.top", "TOP\r\n");
    f.dialog.Check_lastadd.userToggle();
    f.dialog.Text2.setText("2");
    ASSERT_TRUE(f.dialog.Combo1.setText("Top"));
    f.exportNow();
    const std::string top = f.out.get("Movies.TXT");
    EXPECT_TRUE(top.starts_with("\r\n  __|_____________")) << top.substr(0, 80);
    EXPECT_NE(top.find("|  2 |amelie"), std::string::npos);
    EXPECT_NE(top.find("------'\r\n\r\nTOP\r\n.[Movies]"), std::string::npos);
    EXPECT_TRUE(top.ends_with("v. 0.90\r\n\r\n"));

    ASSERT_TRUE(f.dialog.Combo1.setText("Bottom"));
    f.exportNow();
    const std::string bottom = f.out.get("Movies.TXT");
    EXPECT_TRUE(bottom.starts_with("TOP\r\n.[Movies]"));
    EXPECT_NE(bottom.find("--------'\r\n\r\n  __|_____________"), std::string::npos);
    EXPECT_LT(bottom.find("LAST ADDED"), bottom.find("v. 0.90"));
}

TEST(ExportRun, MissingListFilesAreNamedAndTheDialogStaysUsable) {
    for (const char* missing : {"Movies.dat", "Movies.inf", "Movies.art"}) {
        OpenMovies f;
        f.dialog.Checkart.userToggle();
        std::filesystem::remove(f.main.folder.file(missing));
        f.main.platform.answer(Answer::Ok);
        ASSERT_TRUE(f.dialog.Command1.click());
        ASSERT_EQ(f.main.platform.shown().size(), 1u) << missing;
        const auto& box = f.main.platform.shown().back();
        EXPECT_EQ(box.title, "Error");
        EXPECT_EQ(box.style, 16);
        EXPECT_NE(box.prompt.find(missing), std::string::npos) << box.prompt;
        EXPECT_TRUE(f.dialog.window.isEnabled());
        EXPECT_EQ(f.out.listing(), "");
    }
}

TEST(ExportRun, AFailedWriteKeepsTheOlderReport) {
    OpenMovies f;
    f.out.put("Movies.TXT", "older report\r\n");
    ::chmod(f.out.file("Movies.TXT").c_str(), 0444);
    f.main.platform.answer(Answer::Ok);
    ASSERT_TRUE(f.dialog.Command1.click());
    ASSERT_EQ(f.main.platform.shown().size(), 1u);
    EXPECT_EQ(f.main.platform.shown().back().title, "Error");
    EXPECT_NE(f.main.platform.shown().back().prompt.find("Movies.TXT"), std::string::npos);
    EXPECT_EQ(f.out.get("Movies.TXT"), "older report\r\n");
    EXPECT_EQ(f.out.listing(), "Movies.TXT\n");
    EXPECT_TRUE(f.dialog.window.isEnabled());
}

TEST(ExportRun, NoSelectedListOnlyBeeps) {
    OpenMovies f;
    f.main.view.List_list.setSelected(0, false);
    const int beeps = f.main.platform.beeps();
    ASSERT_TRUE(f.dialog.Command1.click());
    EXPECT_EQ(f.main.platform.beeps(), beeps + 1);
    EXPECT_TRUE(f.main.platform.shown().empty());
    EXPECT_EQ(f.out.listing(), "");
    EXPECT_TRUE(f.dialog.window.isEnabled());
}

}  // namespace
