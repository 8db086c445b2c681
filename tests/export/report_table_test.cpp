// The report table, compared byte for byte with tables written out by hand from the format.
#include "export/report_table.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <chrono>
#include <iostream>
#include <tuple>

#include "bench/catalogue_maker.h"
#include "catalogue/records.h"
#include "export/html_page.h"
#include "tests/export/export_fixture.h"

namespace {

using export_test::data;
using exporting::BuildReportTable;
using Options = exporting::ReportOptions;  // articles, information, date, separators, counter

// The lines of a file text, each with its CR LF.
std::vector<std::string> linesOf(const std::string& text) {
    std::vector<std::string> lines;
    for (std::size_t at = 0, end; at < text.size(); at = end + 2) {
        end = text.find("\r\n", at);
        lines.push_back(text.substr(at, end + 2 - at));
    }
    return lines;
}

// The same file text with its records of `size` lines in reverse order.
std::string reversedRecords(const std::string& text, std::size_t size) {
    const std::vector<std::string> lines = linesOf(text);
    std::string out;
    for (std::size_t end = lines.size(); end >= size; end -= size) {
        for (std::size_t i = end - size; i < end; ++i) out += lines[i];
    }
    return out;
}

TEST(ReportTable, EachLayoutMatchesItsHandWrittenTable) {
    // The list name, all ten titles or nine, the options, the date and the expected table.
    for (const auto& [list, ten, options, date, expected] :
         {std::tuple{"Movies", false, Options{true, false, true, true, true}, "6.12.2026",
                     "table_article_noinfo.txt"},
          std::tuple{"My whole collection of discs 1", true,
                     Options{true, true, false, false, true}, "6.12.2026",
                     "table_article_info.txt"},
          std::tuple{"Movies", false, Options{}, "6.12.2026", "table_title_noinfo.txt"},
          std::tuple{"Movies", true, Options{false, true, true, true, true}, "06.12.2026",
                     "table_title_info.txt"}}) {
        SCOPED_TRACE(expected);
        // The titles in the order List1 shows them, all ten or without "Casablanca".
        std::vector<std::string> titles = catalogue::entryTitles(data("movies.dat"))->strings();
        if (!ten) std::erase(titles, "Casablanca");
        EXPECT_EQ(
            BuildReportTable(list, data("movies.dat"), data("movies.art"), titles, options, date),
            data(expected));
        // Star, Star Wars and Wars begin or end with one another; with both files reversed
        // each title's look-alikes come first, and the rows must not change.
        EXPECT_EQ(BuildReportTable(list, reversedRecords(data("movies.dat"), 4),
                                   reversedRecords(data("movies.art"), 1), titles, options, date),
                  data(expected));
    }
}

TEST(ReportTable, EmptyTableMissingEntriesAndOversizedRows) {
    EXPECT_EQ(BuildReportTable("Movies", "", "", {}, {true, false, false, true, true}, ""),
              ".[Movies]------------------------------------------.------------------.------.\r\n"
              "|Art#|tiTLE                                        |tYPE              |dISC's|\r\n"
              ">----+---------------------------------------------+------------------+------<\r\n"
              "'----'-[total titles: 0]---------------------------'------------------'------'\r\n");

    // "Ghost" has neither entry nor article line; entries match exactly, article lines in any
    // case, accented letters too, and the first that matches wins.
    const std::string entries =
        "<|?HEAT\r\n<|'Music CD\r\n<||9\r\n<|*x\r\n<|?Heat\r\n<|'Game\r\n<||3\r\n<|*Copy\r\n"
        "<|?Caf\xE9 au lait\r\n<|'LP\r\n<||1\r\n<|*y\r\n";
    const auto lines = linesOf(BuildReportTable(
        "M", entries, "heat#*\\H009\r\nHeat#*\\H001\r\nCAF\xC9 AU LAIT#*\\C001\r\n",
        {"Ghost", "Heat", "Caf\xE9 au lait"}, {true, true}, ""));
    ASSERT_EQ(lines.size(), 7u);
    EXPECT_EQ(lines[3],
              "|    |Ghost                      |                  |      |                 |\r\n");
    EXPECT_EQ(lines[4],
              "|H009|Heat                       |Game              |  3   |Copy             |\r\n");
    EXPECT_EQ(lines[5].substr(0, 6), "|C001|");

    // 27 characters of date leave no room for dashes, and titles are never cut in the
    // layouts without information: both lines grow.
    const auto wide =
        linesOf(BuildReportTable("Movies", "", "", {std::string(50, 'T')}, {false, false, true},
                                 "Saturday 6 December 2026..."));
    EXPECT_EQ(wide[0], ".[Movies]" + std::string(39, '-') + ".-Saturday 6 December 2026...-.\r\n");
    EXPECT_EQ(wide[3].substr(0, 54), "| " + std::string(50, 'T') + "| ");
}

// A hand-edited entry: other text with "<" before the type, information before the discs. Each
// field is the first of its markers after the one before, and missing when none follows.
TEST(ReportTable, FieldsOfAHandEditedEntryAreTheFirstMarkersThatFollow) {
    const std::string entries = "<|?Odd\r\nnote <b>\r\n<|'LP\r\n<|*i\r\n<||2\r\n";
    EXPECT_EQ(linesOf(BuildReportTable("M", entries, "", {"Odd"}, {false, true}, ""))[3],
              "| Odd                        | LP                |   2    |                  |\r\n");
}

// Titles of 7 to 17 bytes, around the eight-byte steps of the lookups: an entry is found only
// under its exact title, an article number under the title in any case. The longer types put
// one, two or all three of an entry's field lines within 64 bytes.
TEST(ReportTable, TitlesAroundEightBytesFindTheirEntryExactlyAndTheirNumberInAnyCase) {
    std::string entries, articles;
    std::vector<std::string> titles;
    const auto typeOf = [](std::size_t size) {
        return "T" + std::to_string(size) + std::string(size * 3 + 6, '.');
    };
    for (const std::size_t size : {7u, 8u, 9u, 16u, 17u}) {
        const std::string title = std::string(size - 1, 'x') + "A",
                          other = title.substr(0, size - 1);
        entries += "<|?" + title + "\r\n<|'" + typeOf(size) + "\r\n<||1\r\n<|*i\r\n";
        articles += other + "a#*\\A" + std::to_string(100 + size) + "\r\n";
        titles.insert(titles.end(), {title, other + "a"});
    }
    // Entries and lines no row asks for, more than the tables are first made for.
    for (int i = 0; i < 40; ++i) {
        entries += "<|?f" + std::to_string(i) + "\r\n<|'\r\n<||\r\n<|*\r\n";
        articles += "f" + std::to_string(i) + "#*\\F001\r\n";
    }
    const auto lines = linesOf(BuildReportTable("M", entries, articles, titles, {true}, ""));
    for (std::size_t i = 0; i < titles.size(); ++i) {
        const std::string number = "A" + std::to_string(100 + titles[i].size());
        const std::string type =
            i % 2 == 0 ? exporting::firstChars(typeOf(titles[i].size()), 17) : "";
        EXPECT_EQ(lines[3 + i], "|" + number + "|" + exporting::padded(titles[i], 45) + "|" +
                                    exporting::padded(type, 18) + "|  " +
                                    exporting::padded(type.empty() ? "" : "1", 4) + "|\r\n");
    }
}

// A page's table is the text table escaped, for rows copied into their cells and rows written
// whole alike, from plain entries and from a hand-edited text.
TEST(ReportTable, PageTableIsTheTextTableEscaped) {
    const std::vector<std::string> titles = {"Tom & Jerry", "<Heat>", "Gone", "Nowhere & <x>",
                                             "Plain"};
    const std::string articles = "<heat>#*\\H&01\r\nTom & jerry#*\\T001\r\nPlain#*\\P<1>\r\n";
    for (const std::string entries :
         {"<|?Tom & Jerry\r\n<|'Cartoon\r\n<||1\r\n<|*A > B\r\n<|?<Heat>\r\n<|'Film\r\n"
          "<||2\r\n<|*\r\n<|?Gone\r\n<|'Game\r\n<||1234567\r\n<|*Copy\r\n",
          "<|?Tom & Jerry\r\n<|'Cartoon\r\n<|*A > B\r\n<||1\r\n<|?<Heat>\r\n<|'Film\r\n"
          "<||2\r\n"}) {
        Options text{true, true, true, true, true};
        Options page = text;
        page.html = true;
        std::string escaped;
        exporting::appendEscaped(escaped,
                                 BuildReportTable("A&B", entries, articles, titles, text, "<1.1>"));
        EXPECT_EQ(BuildReportTable("A&B", entries, articles, titles, page, "<1.1>"), escaped);
    }
}

TEST(ReportTable, LargestListIsBuiltInLinearTime) {
    // The benchmark's largest list with its article file reversed, so that any search from the
    // start of a text per row would show at once (the sanitizers slow every access several
    // times over; a search per row would still take minutes).
    test_support::TempFolder folder;
    bench::writeList(folder.path(), "Big", 32767);
    const std::string entries = folder.get("Big.dat");
    const std::string articles = reversedRecords(folder.get("Big.art"), 1);
    const std::vector<std::string> titles = catalogue::entryTitles(entries)->strings();
    const auto start = std::chrono::steady_clock::now();
    const std::string table =
        BuildReportTable("Big", entries, articles, titles, {true, true, true, true, true}, "1.1");
    const std::chrono::duration<double> took = std::chrono::steady_clock::now() - start;
    std::cout << "[ timing   ] report of 32767 titles: " << took.count() * 1000 << " ms\n";
#if defined(__SANITIZE_ADDRESS__)
    EXPECT_LT(took.count(), 2.0);
#else
    EXPECT_LT(took.count(), 0.5);
#endif
    // Every title has its row and found its number.
    const std::vector<std::string> lines = linesOf(table);
    ASSERT_EQ(lines.size(), 3u + 2 * 32767);
    EXPECT_EQ(std::count_if(lines.begin(), lines.end(),
                            [](const std::string& line) { return line.starts_with("|    |"); }),
              0);
    EXPECT_TRUE(lines.back().starts_with("'----'-[total titles: 32767]")) << lines.back();
}

}  // namespace
