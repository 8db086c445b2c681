#pragma once

#include <string>
#include <string_view>

// The HTML form of a report: the report text in the preformatted block of a minimal page.
namespace exporting {

// The page for a report: ten fixed lines around the report text, every line ending with CR LF.
// A report of k lines gives k + 11 lines (the report's own last CR LF leaves an empty line
// before "</pre>"). The list name and the report are escaped; the bytes stay ISO-8859-1.
std::string HtmlPage(std::string_view listName, std::string_view reportText);

}  // namespace exporting
