#pragma once

#include <optional>
#include <string>
#include <string_view>

// The last-added section of an export: a banner and a small table of the entries added most
// recently, read backwards from the end of the entry file, placed above or below the report.
namespace exporting {

inline constexpr const char* kTooManyLastAdded =
    "More last add's than titels!\r\nExport the list without lastadd's";
inline constexpr const char* kTooManyLastAddedTitle = "ERROR!";

// The amount typed into the amount box: a number at its start after leading spaces (an optional
// sign, digits, an optional decimal point and digits); 0 when the text does not start with one.
double lastAddedAmount(std::string_view text);

// The section for the last `rows` entries of `entryText` (fewer when the text holds fewer),
// with `amountText` shown as typed in its heading. Every line ends with CR LF.
std::string lastAddedSection(std::string_view entryText, std::string_view amountText, long rows,
                             bool information);

// The report with the section in front of it (position exactly "Top", with an empty line between)
// or after it (any other position).
std::string placeLastAdded(std::string_view report, std::string_view section,
                           std::string_view position);

// What the dialog says about the section.
struct LastAddedRequest {
    bool include = false;         // Check_lastadd set
    std::string_view amountText;  // Text2
    std::string_view position;    // Combo1
    bool information = false;     // Check_noinfo clear
    std::size_t titleCount = 0;   // the titles in the main window's List1
};

struct LastAddedResult {
    std::string report;
    // More entries were asked for than the list has: the report is unchanged, and the caller
    // clears Check_lastadd and shows kTooManyLastAdded.
    bool refused = false;
};

// The section the request asks for; nothing when it is not wanted, or when it is refused, which
// sets `refused`. Never fails.
std::optional<std::string> lastAddedFor(std::string_view entryText, const LastAddedRequest& request,
                                        bool& refused);

// The report with the section added as the request says, or unchanged when it is not wanted or
// refused. Never fails.
LastAddedResult BuildLastAdded(std::string_view entryText, std::string report,
                               const LastAddedRequest& request);

}  // namespace exporting
