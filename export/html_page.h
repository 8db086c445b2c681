#pragma once

#include <string>
#include <string_view>

// The HTML form of a report: the report text in the preformatted block of a minimal page.
namespace exporting {

// The page for a report: ten fixed lines around the report text, every line ending with CR LF.
// A report of k lines gives k + 11 lines (the report's own last CR LF leaves an empty line
// before "</pre>"). The list name and the report are escaped; the bytes stay ISO-8859-1.
std::string HtmlPage(std::string_view listName, std::string_view reportText);

// The same page written piece by piece, so that a report is escaped while it is built: the
// lines before the report, the report's pieces escaped, and the lines after it.
void appendPageStart(std::string& out, std::string_view listName);
// Appends `text` with "&", "<" and ">" written as character references, so that a browser
// shows it as it is.
void appendEscaped(std::string& out, std::string_view text);
void appendPageEnd(std::string& out);
// Appends `text`, escaped when it goes into a page.
void appendText(std::string& out, std::string_view text, bool html);

}  // namespace exporting
