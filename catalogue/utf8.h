#pragma once

#include <optional>
#include <string>
#include <string_view>

// Conversions between the catalogue's ISO-8859-1 bytes and UTF-8, the encoding of file names and
// of the CSV files the catalogue exchanges.
namespace catalogue {

// The UTF-8 form of ISO-8859-1 bytes.
std::string latin1ToUtf8(std::string_view latin1);

// Whether every byte is below 128: the text reads the same in ASCII, UTF-8 and ISO-8859-1.
bool isAscii(std::string_view bytes);

// Whether bytes are well-formed UTF-8 (shortest forms, no surrogates, at most U+10FFFF).
bool isUtf8(std::string_view bytes);

// The ISO-8859-1 bytes of well-formed UTF-8 text, or nothing when it holds a character above
// U+00FF; `outside` then receives that character's code point.
std::optional<std::string> utf8ToLatin1(std::string_view utf8, char32_t* outside = nullptr);

// Writes the ISO-8859-1 bytes of well-formed UTF-8 text to `to`, which has room for as many
// bytes as `utf8` holds, and returns the end of what it wrote. Nothing when the text holds a
// character above U+00FF: `outside` then receives that code point.
char* writeAsLatin1(char* to, std::string_view utf8, char32_t* outside = nullptr);

// Appends the ISO-8859-1 bytes of well-formed UTF-8 text to `out`. False when it holds a
// character above U+00FF: `out` is then as it was, and `outside` receives that code point.
bool appendAsLatin1(std::string& out, std::string_view utf8, char32_t* outside = nullptr);

}  // namespace catalogue
