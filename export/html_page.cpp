#include "export/html_page.h"

#include "catalogue/byte_scan.h"
#include "catalogue/file_text.h"

namespace exporting {

using catalogue::kCrLf;

// The runs between the bytes to escape are copied whole.
void appendEscaped(std::string& out, std::string_view text) {
    for (std::size_t at = 0; at < text.size();) {
        const std::size_t special = catalogue::findAnyOf<'&', '<', '>'>(text, at);
        out.append(text.substr(at, special - at));
        if (special == text.size()) break;
        out.append(text[special] == '&' ? "&amp;" : text[special] == '<' ? "&lt;" : "&gt;");
        at = special + 1;
    }
}

void appendText(std::string& out, std::string_view text, bool html) {
    if (html) {
        appendEscaped(out, text);
    } else {
        out.append(text);
    }
}

void appendPageStart(std::string& out, std::string_view listName) {
    out.append("<html>").append(kCrLf);
    out.append("<head>").append(kCrLf);
    out.append("<title>");
    appendEscaped(out, listName);
    out.append("</title>").append(kCrLf);
    out.append("<meta http-equiv=\"Content-Type\" content=\"text/html; charset=iso-8859-1\">")
        .append(kCrLf);
    out.append("</head>").append(kCrLf);
    out.append("<body bgcolor=\"#000000\" text=\"#00AAFF\">").append(kCrLf);
    out.append("<pre>").append(kCrLf);
}

void appendPageEnd(std::string& out) {
    out.append(kCrLf);
    out.append("</pre>").append(kCrLf);
    out.append("</body>").append(kCrLf);
    out.append("</html>").append(kCrLf);
}

std::string HtmlPage(std::string_view listName, std::string_view reportText) {
    // An escape adds at most four bytes; a report's own drawing escapes two bytes of a line.
    std::string page;
    page.reserve(reportText.size() + reportText.size() / 8 + 5 * listName.size() + 256);
    appendPageStart(page, listName);
    appendEscaped(page, reportText);
    appendPageEnd(page);
    return page;
}

}  // namespace exporting
