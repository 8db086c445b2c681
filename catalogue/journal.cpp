#include "catalogue/journal.h"

#include <charconv>
#include <cstdint>

namespace catalogue {

namespace {

constexpr std::string_view kHeader = "PEMLA-JOURNAL 1\n";
// The same as the store's; the journal does not depend on the store.
constexpr std::string_view kStagingSuffix = ".pemla-tmp";

std::uint64_t fnv1a(std::string_view bytes) {
    std::uint64_t hash = 14695981039346656037ull;
    for (unsigned char c : bytes) {
        hash ^= c;
        hash *= 1099511628211ull;
    }
    return hash;
}

bool isPlainName(std::string_view name) {
    return name.find_first_of(std::string_view("/\0", 2)) == std::string_view::npos &&
           name != "." && name != "..";
}

void putName(std::string& out, std::string_view name) {
    out.append(std::to_string(name.size())).push_back(':');
    out.append(name);
}

// Reads "<length>:<bytes>" from the front of `in`.
std::optional<std::string> takeText(std::string_view& in) {
    std::size_t length = 0;
    auto [end, ec] = std::from_chars(in.data(), in.data() + in.size(), length);
    if (ec != std::errc() || end == in.data() || end == in.data() + in.size() || *end != ':') {
        return std::nullopt;
    }
    in.remove_prefix(static_cast<std::size_t>(end - in.data()) + 1);
    if (length > in.size() || length == 0) return std::nullopt;
    std::string text(in.substr(0, length));
    in.remove_prefix(length);
    return text;
}

// Only plain names of the catalogue's own folder are ever journalled for renames and deletions.
std::optional<std::string> takeName(std::string_view& in) {
    std::optional<std::string> name = takeText(in);
    if (name && !isPlainName(*name)) return std::nullopt;
    return name;
}

bool take(std::string_view& in, std::string_view token) {
    if (!in.starts_with(token)) return false;
    in.remove_prefix(token.size());
    return true;
}

}  // namespace

bool isStrayPath(std::string_view path) {
    if (path.find('\0') != std::string_view::npos) return false;
    if (isPlainName(path)) return path.ends_with(".del");
    const std::string_view last = path.substr(path.rfind('/') + 1);
    return path.starts_with('/') && last.size() > kStagingSuffix.size() &&
           last.ends_with(kStagingSuffix) && path.find("/../") == std::string_view::npos;
}

std::string encodeJournal(const JournalPlan& plan) {
    std::string out(kHeader);
    for (const auto& [staged, target] : plan.renames) {
        out.append("R ");
        putName(out, staged);
        out.push_back(' ');
        putName(out, target);
        out.push_back('\n');
    }
    for (const auto& target : plan.deletions) {
        out.append("D ");
        putName(out, target);
        out.push_back('\n');
    }
    for (const auto& path : plan.strays) {
        out.append("X ");
        putName(out, path);
        out.push_back('\n');
    }
    const std::uint64_t hash = fnv1a(out);
    out.append("END ").append(std::to_string(hash)).push_back('\n');
    return out;
}

std::optional<JournalPlan> decodeJournal(std::string_view bytes) {
    const std::size_t endAt = bytes.rfind("END ");
    if (endAt == std::string_view::npos || !bytes.ends_with('\n')) return std::nullopt;
    const std::string_view body = bytes.substr(0, endAt);
    std::string_view tail = bytes.substr(endAt + 4);
    tail.remove_suffix(1);
    std::uint64_t hash = 0;
    auto [end, ec] = std::from_chars(tail.data(), tail.data() + tail.size(), hash);
    if (ec != std::errc() || end != tail.data() + tail.size() || hash != fnv1a(body)) {
        return std::nullopt;
    }
    std::string_view in = body;
    if (!take(in, kHeader)) return std::nullopt;
    JournalPlan plan;
    while (!in.empty()) {
        if (take(in, "R ")) {
            auto staged = takeName(in);
            if (!staged || !take(in, " ")) return std::nullopt;
            auto target = takeName(in);
            if (!target) return std::nullopt;
            plan.renames.emplace_back(std::move(*staged), std::move(*target));
        } else if (take(in, "D ")) {
            auto target = takeName(in);
            if (!target) return std::nullopt;
            plan.deletions.push_back(std::move(*target));
        } else if (take(in, "X ")) {
            auto path = takeText(in);
            if (!path || !isStrayPath(*path)) return std::nullopt;
            plan.strays.push_back(std::move(*path));
        } else {
            return std::nullopt;
        }
        if (!take(in, "\n")) return std::nullopt;
    }
    return plan;
}

}  // namespace catalogue
