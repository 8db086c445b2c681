#include "export/export_settings.h"

#include <pwd.h>
#include <unistd.h>

#include <cmath>
#include <cstdlib>

#include "catalogue/file_text.h"

namespace exporting {

namespace {

using catalogue::kCrLf;
constexpr auto npos = std::string_view::npos;

bool isLineEnd(char c) {
    return c == '\r' || c == '\n';
}

std::string_view trimmed(std::string_view text) {
    while (!text.empty() && text.front() == ' ') text.remove_prefix(1);
    while (!text.empty() && text.back() == ' ') text.remove_suffix(1);
    return text;
}

}  // namespace

std::optional<std::string> SettingsReader::next() {
    if (pos_ >= text_.size()) return std::nullopt;
    while (pos_ < text_.size() && text_[pos_] == ' ') ++pos_;
    std::string value;
    if (pos_ < text_.size() && text_[pos_] == '"') {
        // A doubled quote inside stands for one quote, so any value can be written back.
        for (++pos_; pos_ < text_.size() && !isLineEnd(text_[pos_]); ++pos_) {
            if (text_[pos_] != '"') {
                value.push_back(text_[pos_]);
            } else if (pos_ + 1 < text_.size() && text_[pos_ + 1] == '"') {
                value.push_back(text_[++pos_]);
            } else {
                break;
            }
        }
        const bool closed = pos_ < text_.size() && text_[pos_] == '"';
        if (closed) ++pos_;
        skipPastDelimiter();
        if (!closed) return std::nullopt;
        return value;
    }
    const std::size_t start = pos_;
    while (pos_ < text_.size() && text_[pos_] != ',' && !isLineEnd(text_[pos_])) ++pos_;
    value = std::string(text_.substr(start, pos_ - start));
    skipPastDelimiter();
    return value;
}

void SettingsReader::skipPastDelimiter() {
    while (pos_ < text_.size() && text_[pos_] != ',' && !isLineEnd(text_[pos_])) ++pos_;
    if (pos_ >= text_.size()) return;
    if (text_[pos_] == ',') {
        ++pos_;
        return;
    }
    if (text_[pos_] == '\r' && pos_ + 1 < text_.size() && text_[pos_ + 1] == '\n') ++pos_;
    ++pos_;
}

std::string settingsValue(std::string_view value) {
    // No line can hold a line break: such a value (a folder may have one in its name) is written
    // empty, so it alone falls back to its default instead of moving every later value.
    if (value.find_first_of("\r\n") != npos) return "\"\"";
    const bool cut = value.find(',') != npos ||
                     (!value.empty() && (value.front() == ' ' || value.front() == '"'));
    if (!cut) return std::string(value);
    std::string quoted = "\"";
    for (const char c : value) {
        quoted.push_back(c);
        if (c == '"') quoted.push_back('"');
    }
    return quoted + "\"";
}

std::optional<int> checkValue(std::string_view value) {
    value = trimmed(value);
    if (value.empty()) return 0;
    std::size_t i = 0;
    bool negative = false;
    if (value[i] == '-' || value[i] == '+') negative = value[i++] == '-';
    double number = 0;
    bool digits = false;
    for (; i < value.size() && value[i] >= '0' && value[i] <= '9'; ++i) {
        number = number * 10 + (value[i] - '0');
        digits = true;
    }
    if (i < value.size() && value[i] == '.') {
        double scale = 0.1;
        for (++i; i < value.size() && value[i] >= '0' && value[i] <= '9'; ++i, scale /= 10) {
            number += (value[i] - '0') * scale;
            digits = true;
        }
    }
    if (!digits || i != value.size()) return std::nullopt;
    // The default rounding mode rounds a half to the even neighbour.
    const double rounded = std::nearbyint(negative ? -number : number);
    if (rounded == 0 || rounded == 1 || rounded == 2) return static_cast<int>(rounded);
    return std::nullopt;
}

std::string encodeSettings(const ExportSettings& settings) {
    std::string text = settingsValue(settings.folder);
    text.append(kCrLf);
    for (int check : settings.checks) text.append(catalogue::fileNumber(check)).append(kCrLf);
    text.append(settingsValue(settings.amount)).append(kCrLf);
    text.append(settingsValue(settings.position)).append(kCrLf);
    return text;
}

std::string defaultSettingsText(std::string_view folder) {
    std::string text = settingsValue(folder);
    text.append(kCrLf);
    for (int i = 0; i < 6; ++i) text.append("0").append(kCrLf);
    text.append("10").append(kCrLf).append("Top").append(kCrLf);
    return text;
}

ExportSettings decodeSettings(std::string_view bytes) {
    SettingsReader reader(bytes);
    ExportSettings settings;
    settings.folder = reader.next().value_or("");
    for (int& check : settings.checks) {
        const auto value = reader.next();
        check = value ? checkValue(*value).value_or(0) : 0;
    }
    if (auto amount = reader.next()) settings.amount = std::move(*amount);
    if (auto position = reader.next()) settings.position = std::move(*position);
    return settings;
}

std::string driveOf(const std::vector<std::string>& drives, std::string_view folder) {
    std::string best;
    for (const std::string& drive : drives) {
        if (drive.empty()) continue;
        const bool holds =
            folder == drive ||
            (drive.ends_with('/') ? folder.starts_with(drive) : folder.starts_with(drive + "/"));
        if (holds && drive.size() > best.size()) best = drive;
    }
    return best;
}

std::string homeFolder() {
    if (const char* home = std::getenv("HOME"); home != nullptr && *home != '\0') return home;
    if (const passwd* entry = ::getpwuid(::getuid());
        entry != nullptr && entry->pw_dir != nullptr) {
        return entry->pw_dir;
    }
    return {};
}

}  // namespace exporting
