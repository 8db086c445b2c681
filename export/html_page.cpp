#include "export/html_page.h"

#include "catalogue/byte_scan.h"
#include "catalogue/file_text.h"

namespace exporting {

namespace {

// Appends `text` to `out` with "&", "<" and ">" written as character references, so that a
// browser shows it as it is: the runs between the bytes to escape are copied whole.
void appendEscaped(std::string& out, std::string_view text) {
    for (std::size_t at = 0; at < text.size();) {
        const std::size_t special = catalogue::findAnyOf<'&', '<', '>'>(text, at);
        out.append(text.substr(at, special - at));
        if (special == text.size()) break;
        out.append(text[special] == '&' ? "&amp;" : text[special] == '<' ? "&lt;" : "&gt;");
        at = special + 1;
    }
}

}  // namespace

std::string HtmlPage(std::string_view listName, std::string_view reportText) {
    constexpr std::string_view crlf = catalogue::kCrLf;
    // An escape adds at most four bytes; a report's own drawing escapes two bytes of a line.
    std::string page;
    page.reserve(reportText.size() + reportText.size() / 8 + 5 * listName.size() + 256);
    page.append("<html>").append(crlf);
    page.append("<head>").append(crlf);
    page.append("<title>");
    appendEscaped(page, listName);
    page.append("</title>").append(crlf);
    page.append("<meta http-equiv=\"Content-Type\" content=\"text/html; charset=iso-8859-1\">")
        .append(crlf);
    page.append("</head>").append(crlf);
    page.append("<body bgcolor=\"#000000\" text=\"#00AAFF\">").append(crlf);
    page.append("<pre>").append(crlf);
    appendEscaped(page, reportText);
    page.append(crlf);
    page.append("</pre>").append(crlf);
    page.append("</body>").append(crlf);
    page.append("</html>").append(crlf);
    return page;
}

}  // namespace exporting
