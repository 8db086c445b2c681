#include "catalogue/file_text.h"

#include <climits>
#include <string>

namespace catalogue {

std::vector<std::string_view> splitLines(std::string_view bytes) {
    std::vector<std::string_view> lines;
    std::size_t start = 0;
    while (start < bytes.size()) {
        const std::size_t cr = bytes.find('\r', start);
        if (cr == std::string_view::npos) {
            lines.push_back(bytes.substr(start));
            break;
        }
        lines.push_back(bytes.substr(start, cr - start));
        start = cr + 1;
        if (start < bytes.size() && bytes[start] == '\n') ++start;
    }
    return lines;
}

std::string toFileText(std::string_view bytes) {
    std::string text;
    text.reserve(bytes.size() + 2);
    std::size_t start = 0;
    while (start < bytes.size()) {
        const std::size_t cr = bytes.find('\r', start);
        if (cr == std::string_view::npos) {
            text.append(bytes.substr(start));
            text.append(kCrLf);
            break;
        }
        text.append(bytes.substr(start, cr - start));
        text.append(kCrLf);
        start = cr + 1;
        if (start < bytes.size() && bytes[start] == '\n') ++start;
    }
    return text;
}

std::string forWriting(std::string_view text) {
    std::string out(text);
    if (!out.empty() && !out.ends_with(kCrLf)) out.append(kCrLf);
    return out;
}

std::optional<long> firstNumber(std::string_view bytes) {
    std::size_t i = 0;
    while (i < bytes.size() && (bytes[i] == ' ' || bytes[i] == '\t')) ++i;
    bool negative = false;
    if (i < bytes.size() && (bytes[i] == '-' || bytes[i] == '+')) {
        negative = bytes[i] == '-';
        ++i;
    }
    if (i >= bytes.size() || bytes[i] < '0' || bytes[i] > '9') return std::nullopt;
    long value = 0;
    for (; i < bytes.size() && bytes[i] >= '0' && bytes[i] <= '9'; ++i) {
        const int digit = bytes[i] - '0';
        if (value > (LONG_MAX - digit) / 10) return std::nullopt;  // no such flag or count
        value = value * 10 + digit;
    }
    return negative ? -value : value;
}

long leadingNumber(std::string_view text) {
    return firstNumber(text).value_or(0);
}

std::string fileNumber(long value) {
    return labelNumber(value) + " ";
}

std::string labelNumber(long value) {
    return value < 0 ? std::to_string(value) : " " + std::to_string(value);
}

}  // namespace catalogue
