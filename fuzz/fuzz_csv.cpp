// Any bytes as a CSV file to import: records read back the same after writing them, and the
// Latin-1 / UTF-8 conversions undo each other.
#include <cstdint>
#include <cstdlib>
#include <string>

#include "catalogue/csv.h"

namespace {

std::vector<std::string> copied(const std::vector<std::string_view>& fields) {
    return {fields.begin(), fields.end()};
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string bytes(reinterpret_cast<const char*>(data), size);
    long line = 0;
    for (catalogue::CsvReader reader(bytes); reader.next();) {
        if (reader.line() <= line || reader.fields().empty()) std::abort();
        line = reader.line();
        // A lone empty field writes an empty line, which holds no record.
        const std::vector<std::string> fields = copied(reader.fields());
        if (reader.unclosedQuote() || (fields.size() == 1 && fields[0].empty())) continue;
        const std::string row = catalogue::csvRow(fields);
        catalogue::CsvReader again(row);
        if (!again.next() || copied(again.fields()) != fields || again.next()) std::abort();
    }
    const std::string utf8 = catalogue::latin1ToUtf8(bytes);
    if (!catalogue::isUtf8(utf8) || catalogue::utf8ToLatin1(utf8) != bytes) std::abort();
    // Well-formed text converts unless it holds a character above U+00FF.
    char32_t outside = 0;
    if (catalogue::isUtf8(bytes) && !catalogue::utf8ToLatin1(bytes, &outside) && outside <= 0xFF) {
        std::abort();
    }
    return 0;
}
