#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

// Comma-separated values as spreadsheets write and read them (RFC 4180), and the conversions
// between the catalogue's ISO-8859-1 bytes and the UTF-8 such files are exchanged in.
namespace catalogue {

// The UTF-8 form of ISO-8859-1 bytes.
std::string latin1ToUtf8(std::string_view latin1);

// Whether bytes are well-formed UTF-8 (shortest forms, no surrogates, at most U+10FFFF).
bool isUtf8(std::string_view bytes);

// The ISO-8859-1 bytes of well-formed UTF-8 text, or nothing when it holds a character above
// U+00FF; `outside` then receives that character's code point.
std::optional<std::string> utf8ToLatin1(std::string_view utf8, char32_t* outside = nullptr);

// One field as written: quoted (inner quotes doubled) when it holds a comma, a quote, CR or LF,
// or starts or ends with a space; as it is otherwise.
std::string csvField(std::string_view value);

// Fields joined by commas, ended by CR LF.
std::string csvRow(const std::vector<std::string>& fields);

struct CsvRecord {
    long line = 0;  // the line of the file the record starts on, from 1
    std::vector<std::string> fields;
    bool unclosedQuote = false;  // a quoted field ran to the end of the file
};

// The records of CSV text. Records end at CR LF, LF or CR outside quotes; a quoted field may hold
// commas, line breaks and doubled quotes; text after a closing quote is kept. Lines that hold
// nothing at all are no records. Never fails.
std::vector<CsvRecord> parseCsv(std::string_view text);

}  // namespace catalogue
