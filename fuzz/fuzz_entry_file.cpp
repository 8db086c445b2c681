// Any bytes as an entry file: reading its titles and every edit made on its text.
#include <cstdint>
#include <cstdlib>
#include <string>

#include "catalogue/file_text.h"
#include "catalogue/records.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string bytes(reinterpret_cast<const char*>(data), size);
    const auto titles = catalogue::entryTitles(bytes);
    if (!titles) return 0;
    const std::string text = catalogue::toFileText(bytes);
    const catalogue::Entry added{"New title", "Game", "2", "Boxed"};
    const std::string longer = catalogue::appendEntry(text, added);
    const auto after = catalogue::entryTitles(longer);
    if (!after || after->size() != titles->size() + 1 || after->back() != added.title) std::abort();

    for (std::size_t i = 0; i < titles->size() && i < 16; ++i) {
        const std::string& title = (*titles)[i];
        (void)catalogue::findEntry(text, title);
        if (auto removed = catalogue::removeEntry(text, title)) {
            if (removed->size() >= text.size()) std::abort();
        }
        if (auto replaced = catalogue::replaceEntry(text, title, added)) {
            if (catalogue::findTitleLine(*replaced, added.title) == std::string::npos) std::abort();
        }
    }
    return 0;
}
