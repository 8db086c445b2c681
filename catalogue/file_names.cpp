#include "catalogue/file_names.h"

#include <set>

#include "catalogue/utf8.h"

namespace catalogue {

std::string fileSystemName(std::string_view latin1) {
    return latin1ToUtf8(latin1);
}

std::optional<std::string> latin1Name(std::string_view bytes) {
    return utf8ToLatin1(bytes);
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
