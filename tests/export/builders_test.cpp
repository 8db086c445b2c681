// The last-added section, the HTML page and the settings file, as pure functions.
#include <gtest/gtest.h>

#include "export/export_settings.h"
#include "export/html_page.h"
#include "export/last_added.h"
#include "tests/export/export_fixture.h"

namespace {

using namespace exporting;
using export_test::data;

LastAddedResult lastAdded(const std::string& amount, const std::string& position, bool info,
                          std::size_t count, const std::string& entries = data("movies.dat")) {
    LastAddedRequest request;
    request.include = true;
    request.amountText = amount;
    request.position = position;
    request.information = info;
    request.titleCount = count;
    return BuildLastAdded(entries, "REPORT\r\n", request);
}

std::size_t countOf(const std::string& text, const std::string& piece) {
    std::size_t n = 0;
    for (std::size_t at = text.find(piece); at != std::string::npos;
         at = text.find(piece, at + 1)) {
        ++n;
    }
    return n;
}

TEST(LastAdded, SectionsMatchTheirHandWrittenText) {
    // Amount equal to the count, rows 9 and 10, a discs text cut to 6 characters.
    LastAddedResult result = lastAdded("10", "Bottom", false, 10);
    EXPECT_FALSE(result.refused);
    EXPECT_EQ(result.report, data("lastadd_bottom_10.txt"));
    // "03" shown as typed, with the two-character tail, above the report.
    EXPECT_EQ(lastAdded("03", "Top", true, 10).report, data("lastadd_top_03.txt"));
    // One character, information column, cut type and information.
    EXPECT_EQ(lastAdded("7", "Bottom", true, 10).report, data("lastadd_bottom_7_info.txt"));
    // No amount at all: heading, header, underline and bottom line, no rows.
    EXPECT_EQ(lastAdded("", "Bottom", false, 10).report, data("lastadd_empty_amount.txt"));
}

TEST(LastAdded, AmountsWithoutDigitsOrBelowOneGiveNoRows) {
    std::string expected = data("lastadd_empty_amount.txt");
    expected.replace(expected.find(".-[ LAST"), 8, ".-[x LAST");
    EXPECT_EQ(lastAdded("x", "Bottom", false, 10).report, expected);
    for (const char* amount : {"-5", "0", ".5"}) {
        const LastAddedResult result = lastAdded(amount, "Bottom", false, 10);
        EXPECT_FALSE(result.refused) << amount;
        EXPECT_EQ(countOf(result.report, "\r\n|  "), 0u) << amount;
    }
    // Reading stops at the first character that cannot continue the number.
    EXPECT_EQ(lastAddedAmount(" 7"), 7);
    EXPECT_EQ(lastAddedAmount("2x"), 2);
    EXPECT_EQ(lastAddedAmount("x1"), 0);
}

TEST(LastAdded, MoreThanTheTitlesIsRefusedAndLeavesTheReport) {
    for (auto [amount, count] : {std::pair{"11", 10}, std::pair{"5", 4}, std::pair{"1.5", 1}}) {
        const LastAddedResult result = lastAdded(amount, "Top", false, count);
        EXPECT_TRUE(result.refused) << amount;
        EXPECT_EQ(result.report, "REPORT\r\n") << amount;
    }
    LastAddedRequest off;
    off.amountText = "99";
    off.titleCount = 1;
    const LastAddedResult result = BuildLastAdded(data("movies.dat"), "REPORT\r\n", off);
    EXPECT_FALSE(result.refused);
    EXPECT_EQ(result.report, "REPORT\r\n");
}

TEST(LastAdded, PlacementAndShortEntryFiles) {
    // Only exactly "Top" places the section above.
    EXPECT_TRUE(lastAdded("1", "top", false, 10).report.starts_with("REPORT\r\n\r\n  __|"));
    EXPECT_TRUE(lastAdded("1", "Top", false, 10).report.ends_with("------'\r\n\r\nREPORT\r\n"));
    // The entry file holds two entries while List1 claims five: the rows stop at two.
    const std::string two = "<|?One\r\n<|'a\r\n<||1\r\n<|*i\r\n<|?Two\r\n<|'b\r\n<||2\r\n<|*j\r\n";
    const std::string report = lastAdded("5", "Bottom", false, 5, two).report;
    EXPECT_EQ(countOf(report, "\r\n|  "), 2u);
    EXPECT_NE(report.find("|  1 |Two "), std::string::npos);
    EXPECT_NE(report.find("|  2 |One "), std::string::npos);
}

TEST(HtmlPage, WrapsTheEscapedReportInTheFixedLines) {
    const std::string report = "| Am\xe9lie & <Bruno> |\r\n>-----<\r\n";
    EXPECT_EQ(HtmlPage("Tom & Jerry <1>", report), data("html_page.html"));
    // k report lines give k + 11 lines.
    const std::string five = "a\r\n<b>\r\n\r\nc&d\r\ne\r\n";
    EXPECT_EQ(countOf(HtmlPage("L", five), "\r\n"), 5u + 11);
}

TEST(Settings, EncodesNineLinesAndQuotesWhatTheReaderWouldCut) {
    ExportSettings s;
    s.folder = "/media/discs";
    s.checks = {1, 0, 2, 0, 1, 0};
    s.amount = "7";
    s.position = "Bottom";
    EXPECT_EQ(encodeSettings(s),
              "/media/discs\r\n 1 \r\n 0 \r\n 2 \r\n 0 \r\n 1 \r\n 0 \r\n7\r\nBottom\r\n");
    s.folder = "/media/a, b";
    s.amount = " 5";
    const std::string text = encodeSettings(s);
    EXPECT_TRUE(text.starts_with("\"/media/a, b\"\r\n")) << text;
    const auto back = decodeSettings(text);
    ASSERT_TRUE(back);
    EXPECT_EQ(back->folder, "/media/a, b");
    EXPECT_EQ(back->amount, " 5");
    EXPECT_EQ(back->checks, s.checks);
    EXPECT_EQ(back->position, "Bottom");
    EXPECT_EQ(defaultSettingsText("/home/me"),
              "/home/me\r\n0\r\n0\r\n0\r\n0\r\n0\r\n0\r\n10\r\nTop\r\n");
}

TEST(Settings, ReadingRule) {
    SettingsReader reader("  plain value \r\na,b\r\n\"x, y\" rest,next\n\r\n\"open");
    EXPECT_EQ(reader.next(), "plain value ");
    EXPECT_EQ(reader.next(), "a");
    EXPECT_EQ(reader.next(), "b");
    EXPECT_EQ(reader.next(), "x, y");
    EXPECT_EQ(reader.next(), "next");
    EXPECT_EQ(reader.next(), "");
    EXPECT_EQ(reader.next(), std::nullopt);  // an unclosed quote
    // An unquoted folder with a comma is cut there, and the rest shifts every later value.
    const auto shifted = decodeSettings("/a,1\r\n0\r\n0\r\n0\r\n0\r\n0\r\n0\r\n10\r\nTop\r\n");
    ASSERT_TRUE(shifted);
    EXPECT_EQ(shifted->folder, "/a");
    EXPECT_EQ(shifted->checks[0], 1);
    EXPECT_EQ(shifted->amount, "0");
    EXPECT_EQ(shifted->position, "10");
}

TEST(Settings, CheckValuesRoundHalfToEven) {
    EXPECT_EQ(checkValue("0.5"), 0);
    EXPECT_EQ(checkValue("1.5"), 2);
    EXPECT_EQ(checkValue("2.5"), 2);
    EXPECT_EQ(checkValue("-1"), std::nullopt);
    EXPECT_EQ(checkValue("yes"), std::nullopt);
    EXPECT_EQ(checkValue("1 1"), std::nullopt);
    // Missing lines or values that are not check values fail as a whole.
    EXPECT_EQ(decodeSettings("/tmp\r\n1\r\n1\r\n0\r\n0\r\n"), std::nullopt);
    EXPECT_EQ(decodeSettings("/tmp\r\n1\r\nx\r\n0\r\n0\r\n0\r\n0\r\n10\r\nTop\r\n"), std::nullopt);
}

TEST(Settings, DriveOfAFolderIsTheDeepestVolumeHoldingIt) {
    const std::vector<std::string> drives = {"/", "/home", "/tmp/"};
    EXPECT_EQ(driveOf(drives, "/home/me/discs"), "/home");
    EXPECT_EQ(driveOf(drives, "/home"), "/home");
    EXPECT_EQ(driveOf(drives, "/homework"), "/");
    EXPECT_EQ(driveOf(drives, "/tmp/x"), "/tmp/");
    EXPECT_EQ(driveOf({"/data"}, "/srv"), "");
}

}  // namespace
