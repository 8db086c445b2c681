#include "catalogue/file_names.h"

#include <set>

namespace catalogue {

std::string fileSystemName(std::string_view latin1) {
    std::string out;
    out.reserve(latin1.size());
    for (const char ch : latin1) {
        const auto c = static_cast<unsigned char>(ch);
        if (c < 0x80) {
            out.push_back(ch);
        } else {
            out.push_back(static_cast<char>(0xC0 | (c >> 6)));
            out.push_back(static_cast<char>(0x80 | (c & 0x3F)));
        }
    }
    return out;
}

std::optional<std::string> latin1Name(std::string_view bytes) {
    std::string out;
    out.reserve(bytes.size());
    for (std::size_t i = 0; i < bytes.size(); ++i) {
        const auto c = static_cast<unsigned char>(bytes[i]);
        if (c < 0x80) {
            out.push_back(bytes[i]);
            continue;
        }
        // Only the two-byte forms of U+0080..U+00FF fit Latin-1; overlong forms are no UTF-8.
        if ((c != 0xC2 && c != 0xC3) || i + 1 == bytes.size()) return std::nullopt;
        const auto next = static_cast<unsigned char>(bytes[++i]);
        if ((next & 0xC0) != 0x80) return std::nullopt;
        out.push_back(static_cast<char>(((c & 0x03) << 6) | (next & 0x3F)));
    }
    return out;
}

std::string shownName(std::string_view bytes) {
    return latin1Name(bytes).value_or(std::string(bytes));
}

std::size_t renameLegacyListFiles(Store& store, const std::vector<std::string>& lists) {
    Transaction t = store.begin();
    std::set<std::string> planned;
    std::size_t count = 0;
    for (const std::string& list : lists) {
        const std::string current = fileSystemName(list);
        // An ASCII name, or one the index cannot name as a file, has nothing to move.
        if (current == list || list.find_first_of(std::string_view("/\0", 2)) != std::string::npos)
            continue;
        for (std::string_view ending : kListFileEndings) {
            const std::string from = list + std::string(ending);
            const std::string to = current + std::string(ending);
            // A legacy name that is also some list's new name is left where it is once claimed.
            if (!planned.insert(from).second || !planned.insert(to).second) continue;
            if (!store.exists(from) || store.exists(to)) continue;
            t.rename(from, to);
            ++count;
        }
    }
    t.commit();
    return count;
}

}  // namespace catalogue
