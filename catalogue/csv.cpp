#include "catalogue/csv.h"

#include <bit>
#include <cstring>

#include "catalogue/byte_scan.h"

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

namespace {

// The commas and line ends among the 64 bytes of a text from `from` on, bit 0 for the first;
// bytes past its end are none.
std::uint64_t stopsAt(std::string_view text, std::size_t from) {
    if (text.size() - from >= 64) return stopBits64<',', '\r', '\n'>(text.data() + from);
    char padded[64] = {};
    std::memcpy(padded, text.data() + from, text.size() - from);
    return stopBits64<',', '\r', '\n'>(padded);
}

// The first comma or line end at or after `from`, or the size. Most fields end within the 64
// bytes whose stops are in hand (`stops` for those from `stopsFrom` on), so a row's fields are
// found in one word; the word is read anew only when it holds no further stop.
[[gnu::always_inline]] inline std::size_t plainEnd(std::string_view text, std::size_t& stopsFrom,
                                                   std::uint64_t& stops, std::size_t from) {
    const std::size_t offset = from - stopsFrom;  // unsigned: a `from` before them is far off
    if (offset < 64) {
        if (const std::uint64_t bits = stops >> offset; bits != 0) {
            return from + static_cast<std::size_t>(std::countr_zero(bits));
        }
    }
    const std::size_t size = text.size();
    if (from >= size) return size;
    if (offset >= 64) {
        stopsFrom = from;
        stops = stopsAt(text, from);
        if (stops != 0) return from + static_cast<std::size_t>(std::countr_zero(stops));
    }
    for (;;) {
        stopsFrom += 64;
        if (stopsFrom >= size) return size;
        stops = stopsAt(text, stopsFrom);
        if (stops != 0) return stopsFrom + static_cast<std::size_t>(std::countr_zero(stops));
    }
}

}  // namespace

CsvReader::CsvReader(std::string_view text) : text_(text) {
    if (!text_.empty()) stops_ = stopsAt(text_, 0);
}

std::string_view CsvReader::quotedField() {
    const std::size_t size = text_.size();
    std::size_t from = ++at_;  // the first byte not yet taken into the field
    std::size_t kept = std::string::npos;
    // A field that cannot be a view of the text is gathered in unquoted_. Reserved once for the
    // whole text, so that the views of a record's earlier fields are never moved.
    auto keep = [&](std::string_view piece) {
        if (kept == std::string::npos) {
            if (unquoted_.capacity() < size) unquoted_.reserve(size);
            kept = unquoted_.size();
        }
        unquoted_.append(piece);
    };
    std::string_view piece;
    for (;;) {
        std::size_t i = findAnyOf<'"', '\r', '\n'>(text_, from);
        for (; i < size && text_[i] != '"'; i = findAnyOf<'"', '\r', '\n'>(text_, i + 1)) {
            // A line break inside quotes belongs to the field, but still counts a line.
            if (text_[i] == '\n' || i + 1 >= size || text_[i + 1] != '\n') ++line_;
        }
        if (i >= size) {
            unclosedQuote_ = true;
            piece = text_.substr(from);
            at_ = size;
            break;
        }
        if (i + 1 < size && text_[i + 1] == '"') {
            keep(text_.substr(from, i + 1 - from));  // up to and with one of the two quotes
            from = i + 2;
            continue;
        }
        piece = text_.substr(from, i - from);
        at_ = i + 1;
        break;
    }
    const std::size_t end = plainEnd(text_, stopsFrom_, stops_, at_);
    if (kept == std::string::npos && end == at_) return piece;
    keep(piece);
    keep(text_.substr(at_, end - at_));
    at_ = end;
    return std::string_view(unquoted_).substr(kept);
}

bool CsvReader::next() {
    // Kept in locals while the fields are stored, which the compiler could not tell apart
    // from the reader's own members.
    const std::string_view text = text_;
    const std::size_t size = text.size();
    std::size_t at = at_;
    // Skips the line end at `at`: CR LF, CR or LF.
    auto lineEnd = [&] {
        if (text[at] == '\r' && at + 1 < size && text[at + 1] == '\n') ++at;
        ++at;
        ++line_;
    };
    while (at < size && (text[at] == '\r' || text[at] == '\n')) lineEnd();  // an empty line
    at_ = at;
    if (at >= size) return false;
    fields_.clear();
    unquoted_.clear();
    unclosedQuote_ = false;
    recordLine_ = line_;
    recordStart_ = at;
    std::size_t stopsFrom = stopsFrom_;
    std::uint64_t stops = stops_;
    for (;;) {
        if (at < size && text[at] == '"') {
            at_ = at;
            stopsFrom_ = stopsFrom;
            stops_ = stops;
            fields_.push_back(quotedField());
            at = at_;
            stopsFrom = stopsFrom_;
            stops = stops_;
        } else {
            const std::size_t end = plainEnd(text, stopsFrom, stops, at);
            fields_.emplace_back(text.data() + at, end - at);
            at = end;
        }
        if (at < size && text[at] == ',') {
            ++at;
            continue;
        }
        recordEnd_ = at;
        if (at < size) lineEnd();
        at_ = at;
        stopsFrom_ = stopsFrom;
        stops_ = stops;
        return true;
    }
}

}  // namespace catalogue
