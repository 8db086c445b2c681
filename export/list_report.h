#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "catalogue/store.h"
#include "export/report_table.h"

// A list's report built from its files, apart from any window: what the export dialog writes,
// and what the command line writes with the same choices.
namespace exporting {

// The options that shape a report, each as "is it set".
struct ReportChoices {
    bool articleNumbers = false;  // Checkart
    bool counter = false;         // Checkcounter
    bool date = false;            // Checkdate
    bool separatorLines = false;  // Checkline
    bool noInformation = false;   // Check_noinfo, before the list's flag decides
    bool lastAdded = false;       // Check_lastadd
    bool html = false;            // Checkhtml
    std::string amountText = "10";
    std::string position = "Top";
};

struct ListReport {
    std::string text;               // the file's bytes: the report and a CR LF, or the HTML page
    std::optional<long> flag;       // the list's information flag as read
    bool information = false;       // whether the report has the information column
    bool lastAddedRefused = false;  // more last-added rows asked for than there are titles
};

// The titles of a list in the order the main window shows them. Throws CatalogueError when the
// entry file cannot be read or does not hold whole entries.
list_order::Items listTitles(catalogue::Store& store, const std::string& list);

// The report of `list` over `titles`: the table, the list's optional top text, the last-added
// section as asked (left out when it asks for more rows than there are titles) and the credit
// line. A flag of 1 gives the information column and 0 takes it away, whatever the choice says.
// `date` is shown when the date is chosen. Throws CatalogueError when a list file is missing or
// unreadable (the top text excepted).
ListReport buildListReport(catalogue::Store& store, const std::string& list, TitleList titles,
                           const ReportChoices& choices, std::string_view date);

// The list as CSV in UTF-8: the header "title,type,discs,information,article number", then one
// row per title in the order the main window shows them, its fields and article number found as
// the report finds them. Throws CatalogueError when a list file is missing or unreadable.
std::string listCsv(catalogue::Store& store, const std::string& list);

}  // namespace exporting
