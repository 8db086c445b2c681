// Any bytes as a CSV file to import: records read back the same after writing them, and the
// Latin-1 / UTF-8 conversions undo each other.
#include "catalogue/csv.h"
#include "fuzz/fuzz_target.h"

void fuzzOne(const std::string& bytes) {
    long line = 0;
    for (catalogue::CsvReader reader(bytes); reader.next();) {
        check(reader.line() > line && !reader.fields().empty());
        line = reader.line();
        // A lone empty field writes an empty line, which holds no record.
        const std::vector<std::string> fields(reader.fields().begin(), reader.fields().end());
        if (reader.unclosedQuote() || (fields.size() == 1 && fields[0].empty())) continue;
        const std::string row = catalogue::csvRow(fields);
        catalogue::CsvReader again(row);
        check(again.next() && again.fields() == reader.fields() && !again.next());
    }
    const std::string utf8 = catalogue::latin1ToUtf8(bytes);
    check(catalogue::isUtf8(utf8) && catalogue::utf8ToLatin1(utf8) == bytes);
    // Well-formed text converts unless it holds a character above U+00FF.
    char32_t outside = 0;
    check(!catalogue::isUtf8(bytes) || catalogue::utf8ToLatin1(bytes, &outside) || outside > 0xFF);
}
