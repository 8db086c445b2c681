// The last-added section, the HTML page and the settings file, as pure functions.
#include <gtest/gtest.h>

#include <tuple>

#include "export/export_settings.h"
#include "export/html_page.h"
#include "export/last_added.h"
#include "tests/export/export_fixture.h"

namespace {

using namespace exporting;
using export_test::data;

LastAddedResult lastAdded(const char* amount, const char* position, bool info, std::size_t count,
                          const std::string& entries = data("movies.dat")) {
    return BuildLastAdded(entries, "REPORT\r\n", {true, amount, position, info, count});
}

// The number rows of a last-added section: the lines starting with "|" but its header; -1
// when there is no section.
long rowsOf(const std::string& report) {
    long lines = -1;
    for (std::size_t at = 0; (at = report.find("\r\n|", at)) != std::string::npos; ++at) ++lines;
    return lines;
}

TEST(LastAdded, SectionsMatchTheirHandWrittenText) {
    // Amount equal to the count with a discs text cut to 6; "03" shown as typed with the
    // two-character tail, above; information column with cut texts; no amount, no rows.
    for (auto [amount, position, info, expected] :
         {std::tuple{"10", "Bottom", false, "lastadd_bottom_10.txt"},
          std::tuple{"03", "Top", true, "lastadd_top_03.txt"},
          std::tuple{"7", "Bottom", true, "lastadd_bottom_7_info.txt"},
          std::tuple{"", "Bottom", false, "lastadd_empty_amount.txt"}}) {
        EXPECT_EQ(lastAdded(amount, position, info, 10).report, data(expected)) << expected;
    }
    std::string expected = data("lastadd_empty_amount.txt");
    expected.replace(expected.find(".-[ LAST"), 8, ".-[x LAST");
    EXPECT_EQ(lastAdded("x", "Bottom", false, 10).report, expected);
}

TEST(LastAdded, TheAmountIsALeadingNumberAndNeverMoreThanTheTitles) {
    // The amount, the titles in List1, and the rows (-1: refused, no section added).
    for (auto [amount, titles, rows] :
         {std::tuple{"-5", 10, 0}, std::tuple{"0", 10, 0}, std::tuple{".5", 10, 0},
          std::tuple{"2x", 10, 2}, std::tuple{" 7", 10, 7}, std::tuple{"11", 10, -1},
          std::tuple{"5", 4, -1}, std::tuple{"1.5", 1, -1}}) {
        const LastAddedResult result = lastAdded(amount, "Top", false, titles);
        EXPECT_EQ(result.refused, rows < 0) << amount;
        EXPECT_EQ(rowsOf(result.report), rows) << amount;
    }
    // Without Check_lastadd nothing is refused or added.
    const LastAddedResult off =
        BuildLastAdded(data("movies.dat"), "REPORT\r\n", {false, "99", "Top", false, 1});
    EXPECT_FALSE(off.refused);
    EXPECT_EQ(off.report, "REPORT\r\n");
}

TEST(LastAdded, PlacementAndShortEntryFiles) {
    // Only exactly "Top" places the section above.
    EXPECT_TRUE(lastAdded("1", "top", false, 10).report.starts_with("REPORT\r\n\r\n  __|"));
    EXPECT_TRUE(lastAdded("1", "Top", false, 10).report.ends_with("------'\r\n\r\nREPORT\r\n"));
    // The entry file holds two entries while List1 claims five: the rows stop at two.
    const std::string two = "<|?One\r\n<|'a\r\n<||1\r\n<|*i\r\n<|?Two\r\n<|'b\r\n<||2\r\n<|*j\r\n";
    const std::string report = lastAdded("5", "Bottom", false, 5, two).report;
    EXPECT_EQ(rowsOf(report), 2);
    EXPECT_NE(report.find("|  1 |Two "), std::string::npos);
    EXPECT_NE(report.find("|  2 |One "), std::string::npos);
}

TEST(HtmlPage, WrapsTheEscapedReportInTheFixedLines) {
    EXPECT_EQ(HtmlPage("Tom & Jerry <1>", "| Am\xe9lie & <Bruno> |\r\n>-----<\r\n"),
              data("html_page.html"));
}

TEST(Settings, QuotesWhatTheReaderWouldCutAndReadsItBack) {
    const ExportSettings stored{"/media/\"a\", b", {1, 0, 2, 0, 1, 0}, "\"5", "Bottom"};
    const std::string text = encodeSettings(stored);
    EXPECT_EQ(text,
              "\"/media/\"\"a\"\", b\"\r\n 1 \r\n 0 \r\n 2 \r\n 0 \r\n 1 \r\n 0 \r\n"
              "\"\"\"5\"\r\nBottom\r\n");
    const ExportSettings back = decodeSettings(text);
    EXPECT_EQ(std::tie(back.folder, back.checks, back.amount, back.position),
              std::tie(stored.folder, stored.checks, stored.amount, stored.position));
    // A folder named with a line break is lost alone; the values after it stay in place.
    const ExportSettings split = decodeSettings(encodeSettings({"/a\nb", {1, 1, 1, 1, 1, 1}}));
    EXPECT_EQ(std::tie(split.folder, split.checks, split.amount),
              std::make_tuple(std::string(), std::array<int, 6>{1, 1, 1, 1, 1, 1}, "10"));
}

TEST(Settings, ReadingRuleAndCheckValues) {
    SettingsReader reader("  plain value \r\na,b\r\n\"x, \"\"y\"\"\" rest,next\n\n\r\n\"open");
    for (const char* value : {"plain value ", "a", "b", "x, \"y\"", "next", "", ""}) {
        EXPECT_EQ(reader.next(), value);
    }
    EXPECT_EQ(reader.next(), std::nullopt);  // an unclosed quote

    // Halves round to the even neighbour.
    const std::pair<const char*, std::optional<int>> checks[] = {
        {"0.5", 0}, {"1.5", 2}, {"2.5", 2}, {"-1", {}}, {"yes", {}}, {"1 1", {}}};
    for (const auto& [text, value] : checks) EXPECT_EQ(checkValue(text), value) << text;
}

TEST(Settings, DriveOfAFolderIsTheDeepestVolumeHoldingIt) {
    const std::vector<std::string> drives = {"/", "/home", "/tmp/"};
    const std::pair<const char*, const char*> cases[] = {
        {"/home/me/discs", "/home"}, {"/home", "/home"}, {"/homework", "/"}, {"/tmp/x", "/tmp/"}};
    for (const auto& [folder, drive] : cases) EXPECT_EQ(driveOf(drives, folder), drive) << folder;
    EXPECT_EQ(driveOf({"/data"}, "/srv"), "");
}

}  // namespace
