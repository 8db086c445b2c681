// Any bytes as an article file: finding, renaming and removing a title's line.
#include <cstdint>
#include <cstdlib>
#include <string>

#include "catalogue/file_text.h"
#include "catalogue/records.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string bytes(reinterpret_cast<const char*>(data), size);
    const std::string text = catalogue::toFileText(bytes);
    for (std::string_view line : catalogue::splitLines(bytes)) {
        const std::size_t separator = line.find(catalogue::kArticleSeparator);
        if (separator == std::string_view::npos) continue;
        const std::string title(line.substr(0, separator));
        const auto number = catalogue::findArticleNumber(text, title);
        if (!number || number->size() > 4) std::abort();
        const std::string removed = catalogue::removeArticleLine(text, title);
        if (removed.size() >= text.size()) std::abort();
        const auto renamed = catalogue::renameArticleLine(text, title, "Other");
        if (!renamed) std::abort();
        if (text.find("ther#") == std::string::npos &&
            catalogue::findArticleNumber(*renamed, "Other") != number) {
            std::abort();
        }
        break;
    }
    return 0;
}
