#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "catalogue/utf8.h"

// Comma-separated values as spreadsheets write and read them (RFC 4180). Such files are
// exchanged in UTF-8: catalogue/utf8.h converts.
namespace catalogue {

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
