// The line rule of the catalogue's files, their numbers, Latin-1 letter case, and reading CSV.
#include <gtest/gtest.h>

#include <algorithm>
#include <climits>
#include <stdexcept>
#include <string>
#include <vector>

#include "catalogue/byte_scan.h"
#include "catalogue/csv.h"
#include "catalogue/file_names.h"
#include "catalogue/file_text.h"
#include "catalogue/latin1.h"
#include "catalogue/utf8.h"

namespace catalogue {
namespace {

// The lines of `bytes` joined with '|', to compare a whole split at once.
std::string lines(std::string_view bytes) {
    std::string out;
    for (std::string_view line : splitLines(bytes)) out += std::string(line) + "|";
    return out;
}

// A lone LF is data, only one LF after a CR belongs to the line end, and the end of the file ends
// the last line; bytes pass unchanged.
TEST(FileText, LineRuleEndsAtCrAndSkipsOneLf) {
    const std::pair<std::string, std::string> cases[] = {
        {"", ""},           {"a\r\nb\r\n", "a|b|"}, {"a\r\nb", "a|b|"},
        {"a\rb\r", "a|b|"}, {"x\r\r\ny", "x||y|"},  {"\r\n\r\n", "||"},
        {"a\nb", "a\nb|"},  {"a\r\n\nb", "a|\nb|"}, {"\xE9t\xE9\r\n", "\xE9t\xE9|"}};
    for (const auto& [bytes, split] : cases) EXPECT_EQ(lines(bytes), split) << bytes;
}

TEST(FileText, TextReadAndWrittenEndsEveryLineWithCrLf) {
    EXPECT_EQ(toFileText(""), "");
    EXPECT_EQ(toFileText("a\rb"), "a\r\nb\r\n");
    EXPECT_EQ(toFileText("a\r\n\r\n"), "a\r\n\r\n");
    EXPECT_EQ(toFileText("a\r\n\nb"), "a\r\n\nb\r\n");
    EXPECT_EQ(toFileText("\r"), "\r\n");
    // A lone CR deep in a long text, and one just before the last CR LF.
    const std::string x20(20, 'x');
    EXPECT_EQ(toFileText(x20 + "\r" + x20 + "\r\n"), x20 + "\r\n" + x20 + "\r\n");
    EXPECT_EQ(toFileText(x20 + x20 + "\r\r\n"), x20 + x20 + "\r\n\r\n");
    EXPECT_EQ(forWriting(""), "");
    EXPECT_EQ(forWriting("a"), "a\r\n");
    EXPECT_EQ(forWriting("a\r\nb"), "a\r\nb\r\n");
    EXPECT_EQ(forWriting("a\r\n\r\n"), "a\r\n\r\n");  // an existing empty line stays, none added
}

TEST(FileText, NumbersReadAndWritten) {
    EXPECT_EQ(firstNumber(" 1 "), 1);
    EXPECT_EQ(firstNumber(" 0 \r\n"), 0);
    EXPECT_EQ(firstNumber("-3"), -3);
    EXPECT_EQ(firstNumber("+5"), 5);
    EXPECT_EQ(firstNumber("\t12abc"), 12);
    EXPECT_EQ(firstNumber(std::to_string(LONG_MAX)), LONG_MAX);
    for (std::string bad : {"", "   ", "abc", "- 3", "\r\n1", "99999999999999999999"}) {
        EXPECT_EQ(firstNumber(bad), std::nullopt) << bad;
    }
    EXPECT_EQ(firstNumber(std::to_string(LONG_MAX) + "0"), std::nullopt);
    EXPECT_EQ(leadingNumber("  7 x"), 7);
    EXPECT_EQ(leadingNumber("x7"), 0);

    EXPECT_EQ(fileNumber(1) + fileNumber(0) + fileNumber(-3), " 1  0 -3 ");
    EXPECT_EQ(labelNumber(32767) + labelNumber(0) + labelNumber(-3), " 32767 0-3");

    // Decimals, as the export settings and the last-added amount hold them: value, whether any
    // digit was read, where the reading stopped.
    const struct {
        const char* text;
        double value;
        bool digits;
        std::size_t end;
    } decimals[] = {{"-1.05x", -1.05, true, 5}, {"+20", 20, true, 3}, {".5", 0.5, true, 2},
                    {"3.", 3, true, 2},         {"-", 0, false, 1},   {"x1", 0, false, 0}};
    for (const auto& d : decimals) {
        const Decimal read = readDecimal(d.text);
        EXPECT_DOUBLE_EQ(read.value, d.value) << d.text;
        EXPECT_EQ(read.digits, d.digits) << d.text;
        EXPECT_EQ(read.end, d.end) << d.text;
    }
}

constexpr auto npos = std::string_view::npos;

TEST(FileNames, EveryLatin1NameHasOneUtf8NameAndOnlyThoseDecode) {
    std::string all;
    for (int c = 1; c < 256; ++c) all.push_back(static_cast<char>(c));
    EXPECT_EQ(latin1Name(fileSystemName(all)), all);
    // Overlong, beyond Latin-1, cut short, a stray continuation byte: shown as the bytes.
    for (const std::string bytes :
         {"\xC1\x81", "\xD0\x94", "\xE2\x82\xAC", "a\xC3", "\xC3(", "\xA9"})
        EXPECT_EQ(shownName(bytes), bytes);
}

// A character the list's files cannot hold is named by its code point, four-byte ones included.
// (Converting, and naming a three-byte one, are the import's and the CSV round trip's.)
TEST(Utf8, NamesTheLastFourByteCharacterOutsideLatin1) {
    char32_t outside = 0;
    EXPECT_FALSE(utf8ToLatin1("\xF4\x8F\xBF\xBF", &outside));
    EXPECT_EQ(outside, 0x10FFFF);
}

TEST(Latin1, FoldsAsciiAndAccentedLettersOnly) {
    EXPECT_TRUE(equalsIgnoreCase("Star Wars", "sTAR wARS"));
    EXPECT_TRUE(equalsIgnoreCase("\xC9t\xC9", "\xE9T\xE9"));  // ÉtÉ / éTé
    EXPECT_TRUE(equalsIgnoreCase("\xC0\xDE", "\xE0\xFE"));  // À Þ / à þ, the ends of the range
    EXPECT_TRUE(equalsIgnoreCase("", ""));
    // × ÷ are no letter pair, ß ÿ have no capital here, @ ` and [ { are 0x20 apart but no letters.
    for (auto [a, b] :
         {std::pair{"\xD7", "\xF7"}, {"\xDF", "\xFF"}, {"@", "`"}, {"[", "{"}, {"abc", "abcD"}}) {
        EXPECT_FALSE(equalsIgnoreCase(a, b)) << a << " " << b;
    }
    EXPECT_EQ(upperByte('a'), 'A');
    EXPECT_EQ(upperByte(0xE0), 0xC0);
    EXPECT_EQ(upperByte(0xFE), 0xDE);
    for (int same : {0xFF, 0xF7, 0xDF, 0xC9, 0x7B, 0x60}) EXPECT_EQ(upperByte(same), same) << same;
}

TEST(Latin1, FindIgnoreCase) {
    EXPECT_EQ(findIgnoreCase("x <|?CAF\xC9\r", "<|?caf\xE9\r"), 2u);
    EXPECT_EQ(findIgnoreCase("abcABC", "abc", 1), 3u);
    EXPECT_EQ(findIgnoreCase("abc", "ABC", 3), npos);
    EXPECT_EQ(findIgnoreCase("abc", "", 2), 2u);
    EXPECT_EQ(findIgnoreCase("abc", "a", 4), npos);
    EXPECT_EQ(findIgnoreCase("\xD7\xF7", "\xF7\xF7"), npos);
    EXPECT_EQ(findIgnoreCase("ab", "abc"), npos);
    // A long text of near misses still finds the one real occurrence at its end.
    EXPECT_EQ(findIgnoreCase(std::string(100000, 'a') + "aAB", "AAB"), 100000u);
}

// A long list box's items: sorted by their leading bytes' digits, then moved one at a time and
// packed once most of their buffer is texts taken out; always the order one sort would give.
TEST(Latin1, ItemsStayInOrderThroughInsertsAndRemovals) {
    std::vector<std::string> texts;
    for (unsigned n = 0; n < 3000; ++n) {
        const unsigned m = n * 2654435761u;
        std::string text = std::to_string(m % 977) + (m & 1 ? "\xC9t\xE9 " : "\xE9T\xC9 ");
        text.insert(m % 3, m & 2 ? "Road " : "ROAD ");
        texts.push_back(text + (m & 4 ? "" : std::to_string(n)));
    }
    std::sort(texts.begin(), texts.end());
    texts.erase(std::unique(texts.begin(), texts.end()), texts.end());
    list_order::Items items(texts);
    std::sort(texts.begin(), texts.end(), itemLess);
    ASSERT_EQ(items.strings(), texts);
    for (std::size_t i = 0; i < 2500; ++i) {
        const std::string gone = texts[(i * 7919) % texts.size()];
        std::erase(texts, gone);
        EXPECT_NE(items.remove(gone), list_order::Items::npos) << gone;
    }
    EXPECT_EQ(items.remove("not there"), list_order::Items::npos);
    for (const std::string added : {"0", "road", "ROAD", "\xFF", "Road 5"}) {
        texts.insert(std::upper_bound(texts.begin(), texts.end(), added, itemLess), added);
        EXPECT_EQ(items[items.insert(added)], added);
    }
    EXPECT_EQ(items.strings(), texts);
    EXPECT_THROW(items.at(items.size()), std::out_of_range);
}

// Counting a byte sixteen at a time, with the counters summed every 255 blocks, counts as one by
// one would, from and to anywhere.
TEST(ByteScan, CountOfCountsAsOneByOneWould) {
    std::string text(5000, '\r');  // a counter overflows at 256 of them
    text.resize(12000, 'x');
    for (std::size_t i = 5000; i < text.size(); i += 1 + i % 5) text[i] = '\r';
    for (const auto& [from, to] : std::vector<std::pair<std::size_t, std::size_t>>{
             {0, 12000}, {3, 4083}, {1, 4097}, {17, 11000}, {5, 5}, {0, 15}}) {
        EXPECT_EQ(countOf<'\r'>(text, from, to), static_cast<std::size_t>(std::count(
                                                     text.begin() + from, text.begin() + to, '\r')))
            << from << ".." << to;
    }
}

// Each record as "line:field|field|...", "!" after it when a quoted field stays open; then the
// record's own text. Fields that had to be unquoted stay whole beside each other; the scans eight
// bytes at a time stop at a break in any place of a word.
TEST(Csv, ReaderGivesEveryFieldAndTheLineItStartsOn) {
    const struct {
        std::string text, records;
    } cases[] = {
        {"a,\"b\"\"c\"x,\"d\"\"\"\"\",\"e,f\"\r\n\r\n\n1234567,123456789\r",
         "1:a|b\"cx|d\"\"|e,f <a,\"b\"\"c\"x,\"d\"\"\"\"\",\"e,f\"> 4:1234567|123456789 "
         "<1234567,123456789> "},
        {"\"two\r\nlines\rthree\",z\n,\n\"open,\r\nend",
         "1:two\r\nlines\rthree|z <\"two\r\nlines\rthree\",z> 4:| <,> 5:open,\r\nend! "
         "<\"open,\r\nend> "},
        // Commas and line ends are looked for 64 bytes at a time: fields that end on the last
        // byte of such a stretch and start on the first of the next, one longer than two of
        // them, and a quoted field on the first byte of a stretch.
        {std::string(63, 'a') + ",b," + std::string(130, 'c') + ",d\r\n" + std::string(55, 'e') +
             ",\"q\"\"\"x",
         "1:" + std::string(63, 'a') + "|b|" + std::string(130, 'c') + "|d <" +
             std::string(63, 'a') + ",b," + std::string(130, 'c') +
             ",d> 2:" + std::string(55, 'e') + "|q\"x <" + std::string(55, 'e') + ",\"q\"\"\"x> "},
    };
    for (const auto& c : cases) {
        std::string records;
        for (CsvReader reader(c.text); reader.next();) {
            records += std::to_string(reader.line()) + ":";
            for (std::size_t i = 0; i < reader.fields().size(); ++i) {
                records += std::string(i > 0 ? "|" : "") + std::string(reader.fields()[i]);
            }
            records += std::string(reader.unclosedQuote() ? "!" : "") + " <" +
                       std::string(reader.raw()) + "> ";
        }
        EXPECT_EQ(records, c.records);
    }
}

}  // namespace
}  // namespace catalogue
