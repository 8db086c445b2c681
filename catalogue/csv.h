#pragma once

#include <cstdint>
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

// Reads CSV text one record at a time. Records end at CR LF, LF or CR outside quotes; a quoted
// field may hold commas, line breaks and doubled quotes; text after a closing quote is kept.
// Lines that hold nothing at all are no records. Never fails.
//
// Fields are views into the text itself, except a quoted field that had to be unquoted (a doubled
// quote, text after the closing quote), which is a view into the reader's own buffer. Either
// stays valid until the next call of next(); the text must outlive the reader.
class CsvReader {
  public:
    explicit CsvReader(std::string_view text);

    // Moves to the next record; false when the text holds no more.
    bool next();

    const std::vector<std::string_view>& fields() const { return fields_; }
    // The line of the text the record starts on, from 1.
    long line() const { return recordLine_; }
    // Whether a quoted field of the record ran to the end of the text.
    bool unclosedQuote() const { return unclosedQuote_; }
    // The record as it stands in the text, without its line end.
    std::string_view raw() const { return text_.substr(recordStart_, recordEnd_ - recordStart_); }

  private:
    std::string_view quotedField();

    std::string_view text_;
    std::size_t at_ = 0;
    // Where the commas and line ends of 64 bytes of the text stand, from stopsFrom_ on: the
    // fields of a row are found in one such word, not by a scan each.
    std::size_t stopsFrom_ = 0;
    std::uint64_t stops_ = 0;
    long line_ = 1;
    long recordLine_ = 0;
    std::size_t recordStart_ = 0, recordEnd_ = 0;
    bool unclosedQuote_ = false;
    std::vector<std::string_view> fields_;
    std::string unquoted_;
};

}  // namespace catalogue
