#include "catalogue/file_text.h"

#include <climits>
#include <string>

#if defined(__SSE2__)
#include <emmintrin.h>
#endif

namespace catalogue {

std::vector<std::string_view> splitLines(std::string_view bytes) {
    std::vector<std::string_view> lines;
    for (std::size_t start = 0; start < bytes.size();) {
        const Line line = lineAt(bytes, start);
        lines.push_back(line.text);
        start = line.next;
    }
    return lines;
}

namespace {

// Whether the bytes are a file text already: every CR followed by LF, and CR LF at the end. A file
// the program wrote always is, so it is taken whole rather than line by line.
bool isFileText(std::string_view bytes) {
    if (bytes.empty()) return true;
    if (!bytes.ends_with(kCrLf)) return false;
    const char* const data = bytes.data();
    const std::size_t size = bytes.size();
    std::size_t at = 0;
#if defined(__SSE2__)
    // Sixteen bytes at a time: the CRs of a block, and the LFs one byte further on.
    for (; at + 17 <= size; at += 16) {
        const __m128i here = _mm_loadu_si128(reinterpret_cast<const __m128i*>(data + at));
        const __m128i next = _mm_loadu_si128(reinterpret_cast<const __m128i*>(data + at + 1));
        const int crs = _mm_movemask_epi8(_mm_cmpeq_epi8(here, _mm_set1_epi8('\r')));
        const int lfs = _mm_movemask_epi8(_mm_cmpeq_epi8(next, _mm_set1_epi8('\n')));
        if ((crs & ~lfs) != 0) return false;
    }
#endif
    // The last byte is LF, so every CR has a byte after it.
    for (; at < size; ++at) {
        if (data[at] == '\r' && data[at + 1] != '\n') return false;
    }
    return true;
}

}  // namespace

std::string toFileText(std::string&& bytes) {
    if (isFileText(bytes)) return std::move(bytes);
    return toFileText(std::string_view(bytes));
}

std::string toFileText(std::string_view bytes) {
    if (isFileText(bytes)) return std::string(bytes);
    std::string text;
    text.reserve(bytes.size() + 2);
    for (std::size_t start = 0; start < bytes.size();) {
        const Line line = lineAt(bytes, start);
        text.append(line.text).append(kCrLf);
        start = line.next;
    }
    return text;
}

std::string forWriting(std::string&& text) {
    if (!text.empty() && !text.ends_with(kCrLf)) text.append(kCrLf);
    return std::move(text);
}

std::string forWriting(std::string_view text) {
    return forWriting(std::string(text));
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

Decimal readDecimal(std::string_view text) {
    Decimal d;
    std::size_t i = 0;
    bool negative = false;
    if (i < text.size() && (text[i] == '-' || text[i] == '+')) negative = text[i++] == '-';
    for (; i < text.size() && text[i] >= '0' && text[i] <= '9'; ++i) {
        d.value = d.value * 10 + (text[i] - '0');
        d.digits = true;
    }
    if (i < text.size() && text[i] == '.') {
        double scale = 0.1;
        for (++i; i < text.size() && text[i] >= '0' && text[i] <= '9'; ++i, scale /= 10) {
            d.value += (text[i] - '0') * scale;
            d.digits = true;
        }
    }
    if (negative) d.value = -d.value;
    d.end = i;
    return d;
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
