#include "catalogue/csv.h"

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

std::size_t CsvReader::plainEnd(std::size_t from) const {
    return findAnyOf<',', '\r', '\n'>(text_, from);
}

void CsvReader::skipLineEnd() {
    if (text_[at_] == '\r' && at_ + 1 < text_.size() && text_[at_ + 1] == '\n') ++at_;
    ++at_;
    ++line_;
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
    const std::size_t end = plainEnd(at_);
    if (kept == std::string::npos && end == at_) return piece;
    keep(piece);
    keep(text_.substr(at_, end - at_));
    at_ = end;
    return std::string_view(unquoted_).substr(kept);
}

bool CsvReader::next() {
    while (at_ < text_.size() && (text_[at_] == '\r' || text_[at_] == '\n')) {
        skipLineEnd();  // an empty line
    }
    if (at_ >= text_.size()) return false;
    fields_.clear();
    unquoted_.clear();
    unclosedQuote_ = false;
    recordLine_ = line_;
    recordStart_ = at_;
    for (;;) {
        if (at_ < text_.size() && text_[at_] == '"') {
            fields_.push_back(quotedField());
        } else {
            const std::size_t end = plainEnd(at_);
            fields_.push_back(text_.substr(at_, end - at_));
            at_ = end;
        }
        if (at_ < text_.size() && text_[at_] == ',') {
            ++at_;
            continue;
        }
        recordEnd_ = at_;
        if (at_ < text_.size()) skipLineEnd();
        return true;
    }
}

}  // namespace catalogue
