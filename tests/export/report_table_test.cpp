// The report table, compared byte for byte with tables written out by hand from the format.
#include "export/report_table.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <iostream>

#include "tests/export/export_fixture.h"

namespace {

using export_test::data;
using exporting::BuildReportTable;
using exporting::ReportOptions;

ReportOptions options(bool art, bool info, bool date, bool lines, bool counter) {
    ReportOptions o;
    o.articleNumbers = art;
    o.information = info;
    o.date = date;
    o.separatorLines = lines;
    o.counter = counter;
    return o;
}

// The lines of a file text, each with its CR LF.
std::vector<std::string> linesOf(const std::string& text) {
    std::vector<std::string> lines;
    std::size_t start = 0;
    while (start < text.size()) {
        const std::size_t end = text.find("\r\n", start);
        lines.push_back(text.substr(start, end + 2 - start));
        start = end + 2;
    }
    return lines;
}

// The same file text with its records (groups of `size` lines) in reverse order.
std::string reversedRecords(const std::string& text, std::size_t size) {
    const std::vector<std::string> lines = linesOf(text);
    std::string out;
    for (std::size_t group = lines.size() / size; group-- > 0;) {
        for (std::size_t i = 0; i < size; ++i) out += lines[group * size + i];
    }
    return out;
}

TEST(ReportTable, EachLayoutMatchesItsHandWrittenTable) {
    const std::string entries = data("movies.dat");
    const std::string articles = data("movies.art");
    // Article layout, no information: a date of 9 characters, separator lines, 9 titles counted.
    EXPECT_EQ(BuildReportTable("Movies", entries, articles, export_test::nineTitles(),
                               options(true, false, true, true, true), "6.12.2026"),
              data("table_article_noinfo.txt"));
    // Article layout with information: a list name of 30 characters, 10 titles counted.
    EXPECT_EQ(BuildReportTable("My whole collection of discs 1", entries, articles,
                               export_test::tenTitles(), options(true, true, false, false, true),
                               "6.12.2026"),
              data("table_article_info.txt"));
    // Title layout, no information: nothing optional.
    EXPECT_EQ(BuildReportTable("Movies", entries, articles, export_test::nineTitles(),
                               options(false, false, false, false, false), "6.12.2026"),
              data("table_title_noinfo.txt"));
    // Title layout with information: a date of 10 characters, separator lines, counter.
    EXPECT_EQ(BuildReportTable("Movies", entries, articles, export_test::tenTitles(),
                               options(false, true, true, true, true), "06.12.2026"),
              data("table_title_info.txt"));
}

TEST(ReportTable, RowsFollowTheirOwnEntryWhateverTheFileOrder) {
    // Star, Star Wars and Wars begin or end with one another; reversing both files puts each
    // title's neighbours first, and the rows must not change.
    const std::string entries = reversedRecords(data("movies.dat"), 4);
    const std::string articles = reversedRecords(data("movies.art"), 1);
    ASSERT_NE(entries, data("movies.dat"));
    EXPECT_EQ(
        BuildReportTable("My whole collection of discs 1", entries, articles,
                         export_test::tenTitles(), options(true, true, false, false, true), "x"),
        data("table_article_info.txt"));
}

TEST(ReportTable, EmptyListAndSingleTitle) {
    const std::string empty =
        BuildReportTable("Movies", "", "", {}, options(true, false, false, true, true), "");
    EXPECT_EQ(empty,
              ".[Movies]------------------------------------------.------------------.------.\r\n"
              "|Art#|tiTLE                                        |tYPE              |dISC's|\r\n"
              ">----+---------------------------------------------+------------------+------<\r\n"
              "'----'-[total titles: 0]---------------------------'------------------'------'\r\n");

    // One title with separator lines on: no separator after the only row.
    const std::string one =
        BuildReportTable("Movies", data("movies.dat"), data("movies.art"), {"Heat"},
                         options(false, false, false, true, false), "");
    EXPECT_EQ(linesOf(one).size(), 5u);
    EXPECT_EQ(linesOf(one)[3],
              "| Heat                                          | Game              |"
              "   3    |\r\n");
}

TEST(ReportTable, TitlesMissingFromTheFilesKeepTheRowLayout) {
    // "Ghost" has neither an entry nor an article line; "Heat" has an entry but no article line.
    const std::string table =
        BuildReportTable("Movies", data("movies.dat"), "Other#*\\O001\r\n", {"Ghost", "Heat"},
                         options(true, true, false, false, false), "");
    const std::vector<std::string> lines = linesOf(table);
    ASSERT_EQ(lines.size(), 6u);
    EXPECT_EQ(lines[3],
              "|    |Ghost                      |                  |      |                 |\r\n");
    EXPECT_EQ(lines[4],
              "|    |Heat                       |Game              |  3   |Copy             |\r\n");
}

TEST(ReportTable, EntriesMatchExactlyButArticleLinesIgnoreCase) {
    const std::string entries =
        "<|?HEAT\r\n<|'Music CD\r\n<||9\r\n<|*x\r\n<|?Heat\r\n<|'Game\r\n<||3\r\n<|*Copy\r\n";
    const std::string table =
        BuildReportTable("M", entries, "heat#*\\H009\r\nHeat#*\\H001\r\n", {"Heat"},
                         options(true, true, false, false, false), "");
    EXPECT_EQ(linesOf(table)[3],
              "|H009|Heat                       |Game              |  3   |Copy             |\r\n");
}

TEST(ReportTable, LongDateAndLongTitlesWidenTheirLines) {
    const std::string table =
        BuildReportTable("Movies", "", "", {std::string(50, 'T')},
                         options(false, false, true, false, false), "Saturday 6 December 2026...");
    const std::vector<std::string> lines = linesOf(table);
    // 27 characters of date leave no room for dashes: 47 + 3 + 27 + 2 characters.
    EXPECT_EQ(lines[0].size(), 79u + 2);
    EXPECT_TRUE(lines[0].ends_with("-.-Saturday 6 December 2026...-.\r\n"));
    // Titles are never cut in the layouts without information.
    EXPECT_EQ(lines[3].substr(0, 54), "| " + std::string(50, 'T') + "| ");
}

#if defined(__SANITIZE_ADDRESS__)
// The sanitizers slow every access several times over; a search per row would still take minutes.
constexpr double kTimeLimit = 2.0;
#else
constexpr double kTimeLimit = 0.5;
#endif

TEST(ReportTable, LargestListIsBuiltInLinearTime) {
    // 32767 titles, the entry file in file order and the article file reversed and in capitals,
    // so that any search from the start of a text per row would show at once.
    const int count = 32767;
    std::string entries;
    std::string articles;
    std::vector<std::string> titles;
    for (int i = 0; i < count; ++i) {
        char title[32];
        std::snprintf(title, sizeof title, "Title %05d", i);
        titles.emplace_back(title);
        entries += "<|?" + std::string(title) + "\r\n<|'Type " + std::to_string(i % 7) + "\r\n<||" +
                   std::to_string(i % 10) + "\r\n<|*Info\r\n";
    }
    for (int i = count; i-- > 0;) {
        char line[48];
        std::snprintf(line, sizeof line, "TITLE %05d#*\\T%03d\r\n", i, i % 1000);
        articles += line;
    }
    const auto start = std::chrono::steady_clock::now();
    const std::string table = BuildReportTable("Big", entries, articles, titles,
                                               options(true, true, true, true, true), "1.1.2027");
    const auto took = std::chrono::duration<double>(std::chrono::steady_clock::now() - start);
    std::cout << "[ timing   ] report of " << count << " titles: " << took.count() * 1000
              << " ms\n";
    EXPECT_LT(took.count(), kTimeLimit);

    const std::vector<std::string> lines = linesOf(table);
    ASSERT_EQ(lines.size(), 3u + 2 * count - 1 + 1);
    EXPECT_EQ(lines[3],
              "|T000|Title 00000                |Type 0            |  0   |Info             |\r\n");
    EXPECT_EQ(lines[lines.size() - 2],
              "|T766|Title 32766                |Type 6            |  6   |Info             |\r\n");
    EXPECT_EQ(lines.back(),
              "'----'-[total titles: 32767]-----'------------------'------'-----------------'\r\n");
}

}  // namespace
