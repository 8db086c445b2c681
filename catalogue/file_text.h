#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

// The text rules every catalogue file follows. Files are bytes (ISO-8859-1); nothing is converted.
// A line ends at CR (an LF right after it belongs to the line end) or at the end of the file.
// A "file text" is the file's lines, each followed by CR LF.
namespace catalogue {

inline constexpr std::string_view kCrLf = "\r\n";

// One line of a file text: its bytes up to the CR, and where the next line starts.
struct Line {
    std::string_view text;
    std::size_t next;
};

// The line starting at `at` by the line rule; past the end, an empty line ending there.
inline Line lineAt(std::string_view bytes, std::size_t at) {
    if (at >= bytes.size()) return {{}, bytes.size()};
    std::size_t cr = bytes.find('\r', at);
    std::size_t next = cr == std::string_view::npos ? bytes.size() : cr + 1;
    if (cr == std::string_view::npos) cr = bytes.size();
    if (next < bytes.size() && bytes[next] == '\n') ++next;
    return {bytes.substr(at, cr - at), next};
}

// Whether a line starts at `at` by the line rule: at the start, after a CR, or after the LF that
// follows a CR (the LF itself, belonging to the line end, starts none).
inline bool startsLine(std::string_view bytes, std::size_t at) {
    return at == 0 || (bytes[at - 1] == '\r' && bytes[at] != '\n') ||
           (bytes[at - 1] == '\n' && at >= 2 && bytes[at - 2] == '\r');
}

// Splits file bytes into lines by the line rule. An empty file has no lines; a lone LF is data.
std::vector<std::string_view> splitLines(std::string_view bytes);

// The file text of some file bytes: every line followed by CR LF. For a file the program wrote,
// this is byte for byte the file itself.
std::string toFileText(std::string_view bytes);
// The same, taking over bytes that are a file text already instead of copying them.
std::string toFileText(std::string&& bytes);
inline std::string toFileText(const char* bytes) {
    return toFileText(std::string_view(bytes));
}

// The bytes to store for a text: unchanged when it ends with CR LF, otherwise followed by one
// CR LF. The empty text stays empty.
std::string forWriting(std::string_view text);
// The same, taking the text over instead of copying it.
std::string forWriting(std::string&& text);
inline std::string forWriting(const char* text) {
    return forWriting(std::string_view(text));
}

// The first number in some bytes, read as a printed integer: leading blanks skipped, an optional
// sign, digits. Nothing when the bytes do not start with a number.
std::optional<long> firstNumber(std::string_view bytes);

// A decimal number at the start of a text: an optional sign, digits, and a point with more digits.
// `digits` says whether any digit was read, `end` where the reading stopped.
struct Decimal {
    double value = 0;
    bool digits = false;
    std::size_t end = 0;
};
Decimal readDecimal(std::string_view text);

// Value of the digits at the start of a text after leading spaces (0 when none): how amounts
// typed into a text box are read.
long leadingNumber(std::string_view text);

// An integer written into a file: a space for the sign, the digits, a space (" 1 ").
std::string fileNumber(long value);

// An integer written into a label or report: the sign place and digits (" 12", "-3").
std::string labelNumber(long value);

}  // namespace catalogue
