#pragma once

#include <array>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

// The export dialog's settings file "export.dat": nine values, one per line, each ended by CR LF.
namespace exporting {

inline constexpr const char* kSettingsFile = "export.dat";

struct ExportSettings {
    std::string folder;
    // Checkart, Checkhtml, Checkcounter, Checkdate, Checkline, Check_lastadd: 0, 1 or 2.
    std::array<int, 6> checks{};
    std::string amount = "10";
    std::string position = "Top";
};

// The file text of some settings: the folder, each check value as " 0 " / " 1 ", the amount and
// the position. The folder and the amount are quoted when the reading rule would cut them.
std::string encodeSettings(const ExportSettings& settings);

// The defaults file for a default output folder: the folder, six bare "0", "10" and "Top".
std::string defaultSettingsText(std::string_view folder);

// Reads the nine values by the reading rule. A value that is missing or unreadable, or a check
// value that is no number a check box takes, keeps its default (an empty folder); the folder and
// the position are checked by whoever applies them.
ExportSettings decodeSettings(std::string_view bytes);

// Reads the values of a settings text one by one: leading spaces are skipped; a value that starts
// with a double quote runs to the next lone one on its line, a doubled quote inside standing for
// one (the rest up to the next comma or line end is dropped); any other value runs to the first
// comma or line end. CR, LF and CR LF end a line.
class SettingsReader {
  public:
    explicit SettingsReader(std::string_view text) : text_(text) {}
    // The next value; nothing at the end of the text, or for a quote left open (that value is
    // skipped and the reader goes on with the next line).
    std::optional<std::string> next();

  private:
    void skipPastDelimiter();
    std::string_view text_;
    std::size_t pos_ = 0;
};

// A value as written to the file: quoted, with its quotes doubled, when it holds a comma or starts
// with a space or a quote, so it reads back whole; written empty when it holds a line break.
// Other values are written as they are.
std::string settingsValue(std::string_view value);

// The check-box value a settings value stands for: a number, surrounding spaces ignored, rounded
// half to even, that is 0, 1 or 2; an empty value is 0. Nothing for anything else.
std::optional<int> checkValue(std::string_view value);

// The volume among `drives` (root paths such as "/" or "/home") that holds `folder`: the longest
// root that is the folder or one of its parent folders. Empty when none holds it.
std::string driveOf(const std::vector<std::string>& drives, std::string_view folder);

// The user's home folder, from HOME or the password database; empty when unknown.
std::string homeFolder();

}  // namespace exporting
