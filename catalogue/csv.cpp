#include "catalogue/csv.h"

namespace catalogue {

std::string csvField(std::string_view value) {
    const bool quote = value.find_first_of(",\"\r\n") != std::string_view::npos ||
                       value.starts_with(' ') || value.ends_with(' ');
    if (!quote) return std::string(value);
    std::string field = "\"";
    for (char c : value) {
        if (c == '"') field.push_back('"');
        field.push_back(c);
    }
    field.push_back('"');
    return field;
}

std::string csvRow(const std::vector<std::string>& fields) {
    std::string row;
    for (std::size_t i = 0; i < fields.size(); ++i) {
        if (i > 0) row.push_back(',');
        row += csvField(fields[i]);
    }
    row += "\r\n";
    return row;
}

std::vector<CsvRecord> parseCsv(std::string_view text) {
    std::vector<CsvRecord> records;
    std::size_t at = 0;
    long line = 1;
    // Steps over the line end at `at` (CR LF, LF or CR), counting the line.
    auto skipLineEnd = [&] {
        if (text[at] == '\r' && at + 1 < text.size() && text[at + 1] == '\n') ++at;
        ++at;
        ++line;
    };
    while (at < text.size()) {
        if (text[at] == '\r' || text[at] == '\n') {
            skipLineEnd();  // an empty line
            continue;
        }
        CsvRecord record;
        record.line = line;
        std::string field;
        bool ended = false;
        while (!ended) {
            if (at < text.size() && text[at] == '"') {
                ++at;
                for (;;) {
                    if (at >= text.size()) {
                        record.unclosedQuote = true;
                        break;
                    }
                    const char c = text[at];
                    if (c == '"') {
                        if (at + 1 < text.size() && text[at + 1] == '"') {
                            field.push_back('"');
                            at += 2;
                            continue;
                        }
                        ++at;
                        break;
                    }
                    // A line break inside quotes belongs to the field, but still counts a line.
                    if (c == '\n' ||
                        (c == '\r' && (at + 1 >= text.size() || text[at + 1] != '\n'))) {
                        ++line;
                    }
                    field.push_back(c);
                    ++at;
                }
            }
            while (at < text.size() && text[at] != ',' && text[at] != '\r' && text[at] != '\n') {
                field.push_back(text[at++]);
            }
            record.fields.push_back(std::move(field));
            field.clear();
            if (at < text.size() && text[at] == ',') {
                ++at;
            } else {
                if (at < text.size()) skipLineEnd();
                ended = true;
            }
        }
        records.push_back(std::move(record));
    }
    return records;
}

}  // namespace catalogue
