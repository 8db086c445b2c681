#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "list_order/list_order.h"

// The report table of an export: every title of the open list as one row of a table drawn in
// ASCII characters, 78 characters wide, under a top border carrying the list's name.
namespace exporting {

// The dialog's check boxes that shape the table, each as "is it set".
struct ReportOptions {
    bool articleNumbers = false;  // Checkart: an "Art#" column first
    bool information = false;     // Check_noinfo clear: an information column last
    bool date = false;            // Checkdate: the date in the top border
    bool separatorLines = false;  // Checkline: the header underline between rows
    bool counter = false;         // Checkcounter: the number of titles in the bottom line
    bool html = false;            // Checkhtml: the table escaped for an HTML page
};

// The titles of a report in their order, held as strings or as views into what holds them. It
// only points at them: what holds them must outlive it.
class TitleList {
  public:
    TitleList() = default;
    TitleList(const std::vector<std::string>& titles)  // NOLINT: converts as the titles it shows
        : strings_(titles.data()), size_(titles.size()) {}
    TitleList(const std::vector<std::string_view>& titles)  // NOLINT
        : views_(titles.data()), size_(titles.size()) {}
    TitleList(const list_order::Items& titles)  // NOLINT
        : items_(&titles), size_(titles.size()) {}

    std::size_t size() const { return size_; }
    std::string_view operator[](std::size_t i) const {
        if (strings_ != nullptr) return strings_[i];
        return views_ != nullptr ? views_[i] : (*items_)[i];
    }

  private:
    const std::string* strings_ = nullptr;
    const std::string_view* views_ = nullptr;
    const list_order::Items* items_ = nullptr;
    std::size_t size_ = 0;
};

// Builds the table for `titles` (the main window's List1, in its order). Each title's type, discs
// and information come from its entry in `entryText` (exact title match), its article number from
// `articleText` (matched ignoring case); both texts are indexed once, so the work is linear. A
// title without an entry gets empty cells, one without an article line a blank number. Never fails.
std::string BuildReportTable(std::string_view listName, std::string_view entryText,
                             std::string_view articleText, const std::vector<std::string>& titles,
                             const ReportOptions& options, std::string_view dateText);

// The same table appended to `out`, so that a report is written into one buffer.
void appendReportTable(std::string& out, std::string_view listName, std::string_view entryText,
                       std::string_view articleText, TitleList titles, const ReportOptions& options,
                       std::string_view dateText);

// About how many bytes the table of `titles` rows takes.
std::size_t reportTableSize(std::size_t titles, const ReportOptions& options);

// `text` cut to its first `width` characters when longer.
std::string firstChars(std::string_view text, std::size_t width);

// `text` with spaces appended up to `width` characters; a longer text stays whole.
std::string padded(std::string_view text, std::size_t width);

}  // namespace exporting
