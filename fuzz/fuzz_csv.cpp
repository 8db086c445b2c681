// Any bytes as a CSV file to import: records read back the same after writing them, and the
// Latin-1 / UTF-8 conversions undo each other.
#include "catalogue/csv.h"
#include "fuzz/fuzz_target.h"

void fuzzOne(const std::string& bytes) {
    long line = 0;
    for (const catalogue::CsvRecord& record : catalogue::parseCsv(bytes)) {
        check(record.line > line && !record.fields.empty());
        line = record.line;
        // A lone empty field writes an empty line, which holds no record.
        if (record.unclosedQuote || (record.fields.size() == 1 && record.fields[0].empty())) {
            continue;
        }
        const auto again = catalogue::parseCsv(catalogue::csvRow(record.fields));
        check(again.size() == 1 && again[0].fields == record.fields);
    }
    const std::string utf8 = catalogue::latin1ToUtf8(bytes);
    check(catalogue::isUtf8(utf8) && catalogue::utf8ToLatin1(utf8) == bytes);
    // Well-formed text converts unless it holds a character above U+00FF.
    char32_t outside = 0;
    check(!catalogue::isUtf8(bytes) || catalogue::utf8ToLatin1(bytes, &outside) || outside > 0xFF);
}
