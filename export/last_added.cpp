#include "export/last_added.h"

#include <cmath>

#include "catalogue/file_text.h"
#include "catalogue/records.h"
#include "export/report_table.h"

namespace exporting {

namespace {

using catalogue::kCrLf;
using catalogue::Line;
using catalogue::lineAt;
constexpr auto npos = std::string_view::npos;

constexpr std::string_view kBanner[] = {
    "  __|_____________                                           _____________|__",
    "    |            /__:_                                   _:__\\            |",
    "    |               |                                     |               |",
    "    |               |  -[ r e s c e n t . t i t l e s ]-  |               |",
    "   _|___            |                                     |            ___|_",
    "    :  /____________|__                                 __|____________\\  :",
    "                    |                                     |",
};
static_assert(kBanner[0].size() == 77 && kBanner[4].size() == 76 && kBanner[6].size() == 59);

// The entry's lines after its title line are taken by position, markers untested.
std::string_view withoutMarker(std::string_view line) {
    return line.size() > 3 ? line.substr(3) : std::string_view();
}

std::string numberCell(long k) {
    const std::string digits = std::to_string(k);
    return (k < 10 ? "|  " : "| ") + digits + " |";
}

}  // namespace

double lastAddedAmount(std::string_view text) {
    std::size_t i = 0;
    while (i < text.size() && text[i] == ' ') ++i;
    return catalogue::readDecimal(text.substr(i)).value;
}

std::string lastAddedSection(std::string_view entryText, std::string_view amountText, long rows,
                             bool information) {
    std::string s(kCrLf);
    for (std::string_view line : kBanner) s.append(line).append(kCrLf);
    s.append(kCrLf);

    s.append(".-[").append(amountText);
    if (amountText.size() == 2) {
        s.append(information
                     ? " LAST ADDED TITLES]---------.------------------.------.-----------------."
                     : " LAST ADDED TITLES]---------------------------.------------------.------.");
    } else {
        s.append(
            information
                ? " LAST ADDED TITLES]----------.------------------.------.-----------------."
                : " LAST ADDED TITLES]----------------------------.------------------.------.");
    }
    s.append(kCrLf);
    s.append(
        information
            ? "| nr |tiTLE                      |tYPE              |dISC's|iNFORMATiOn      |"
            : "| nr |tiTLE                                        |tYPE              |dISC's|");
    s.append(kCrLf);
    s.append(
        information
            ? ">----+---------------------------+------------------+------+-----------------<"
            : ">----+---------------------------------------------+------------------+------<");
    s.append(kCrLf);

    // Entries stand in the order they were added, so walking back from the end of the text
    // gives the newest first. The rows stop early when the text runs out of entries.
    std::size_t searchFrom = entryText.size();
    for (long k = 1; k <= rows; ++k) {
        const std::size_t at = entryText.rfind(catalogue::kTitleTag, searchFrom);
        if (at == npos) break;
        const Line title = lineAt(entryText, at);
        const Line type = lineAt(entryText, title.next);
        const Line discs = lineAt(entryText, type.next);
        const Line info = lineAt(entryText, discs.next);

        s.append(numberCell(k));
        const std::string_view name = title.text.substr(catalogue::kTitleTag.size());
        s.append(information ? padded(firstChars(name, 26), 27) : padded(name, 45));
        s.append("|").append(padded(firstChars(withoutMarker(type.text), 17), 18));
        s.append("|  ").append(padded(firstChars(withoutMarker(discs.text), 6), 4));
        if (information) {
            s.append("|").append(padded(firstChars(withoutMarker(info.text), 16), 17));
        }
        s.append("|").append(kCrLf);

        if (at == 0) break;
        searchFrom = at - 1;
    }

    s.append(
        information
            ? "'----'---------------------------'------------------'------'-----------------'"
            : "'----'---------------------------------------------'------------------'------'");
    s.append(kCrLf);
    return s;
}

std::string placeLastAdded(std::string_view report, std::string_view section,
                           std::string_view position) {
    std::string out;
    out.reserve(report.size() + section.size() + 2);
    if (position == "Top") {
        out.append(section).append(kCrLf).append(report);
    } else {
        out.append(report).append(section);
    }
    return out;
}

std::optional<std::string> lastAddedFor(std::string_view entryText, const LastAddedRequest& request,
                                        bool& refused) {
    refused = false;
    if (!request.include) return std::nullopt;
    const double amount = lastAddedAmount(request.amountText);
    if (amount > static_cast<double>(request.titleCount)) {
        refused = true;
        return std::nullopt;
    }
    const long rows = amount >= 1 ? static_cast<long>(std::floor(amount)) : 0;
    return lastAddedSection(entryText, request.amountText, rows, request.information);
}

LastAddedResult BuildLastAdded(std::string_view entryText, std::string report,
                               const LastAddedRequest& request) {
    LastAddedResult result{std::move(report), false};
    if (const std::optional<std::string> section =
            lastAddedFor(entryText, request, result.refused)) {
        result.report = placeLastAdded(result.report, *section, request.position);
    }
    return result;
}

}  // namespace exporting
