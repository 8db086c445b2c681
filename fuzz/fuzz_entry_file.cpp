// Any bytes as an entry file: reading its titles and every edit made on its text.
#include "catalogue/file_text.h"
#include "catalogue/records.h"
#include "fuzz/fuzz_target.h"

void fuzzOne(const std::string& bytes) {
    const auto titles = catalogue::entryTitles(bytes);
    if (!titles) return;
    const std::string text = catalogue::toFileText(bytes);
    const catalogue::Entry added{"New title", "Game", "2", "Boxed"};
    const auto after = catalogue::entryTitles(catalogue::appendEntry(text, added));
    check(after && after->size() == titles->size() + 1 &&
          after->find(added.title) != list_order::Items::npos);
    for (std::size_t i = 0; i < titles->size() && i < 16; ++i) {
        const std::string title((*titles)[i]);
        (void)catalogue::findEntry(text, title);
        if (auto removed = catalogue::removeEntry(text, title))
            check(removed->size() < text.size());
        if (auto replaced = catalogue::replaceEntry(text, title, added)) {
            check(catalogue::findTitleLine(*replaced, added.title) != std::string::npos);
        }
    }
}
