#include "export/html_page.h"

#include "catalogue/file_text.h"

namespace exporting {

std::string htmlEscape(std::string_view text) {
    std::string out;
    out.reserve(text.size() + text.size() / 8);
    for (char c : text) {
        switch (c) {
            case '&':
                out.append("&amp;");
                break;
            case '<':
                out.append("&lt;");
                break;
            case '>':
                out.append("&gt;");
                break;
            default:
                out.push_back(c);
                break;
        }
    }
    return out;
}

std::string HtmlPage(std::string_view listName, std::string_view reportText) {
    constexpr std::string_view crlf = catalogue::kCrLf;
    std::string page;
    page.reserve(reportText.size() + reportText.size() / 4 + 256);
    page.append("<html>").append(crlf);
    page.append("<head>").append(crlf);
    page.append("<title>").append(htmlEscape(listName)).append("</title>").append(crlf);
    page.append("<meta http-equiv=\"Content-Type\" content=\"text/html; charset=iso-8859-1\">")
        .append(crlf);
    page.append("</head>").append(crlf);
    page.append("<body bgcolor=\"#000000\" text=\"#00AAFF\">").append(crlf);
    page.append("<pre>").append(crlf);
    page.append(htmlEscape(reportText)).append(crlf);
    page.append("</pre>").append(crlf);
    page.append("</body>").append(crlf);
    page.append("</html>").append(crlf);
    return page;
}

}  // namespace exporting
