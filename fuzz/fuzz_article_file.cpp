// Any bytes as an article file: finding, renaming and removing a title's line.
#include "catalogue/file_text.h"
#include "catalogue/records.h"
#include "export/title_index.h"
#include "fuzz/fuzz_target.h"

void fuzzOne(const std::string& bytes) {
    const std::string text = catalogue::toFileText(bytes);
    for (std::string_view line : catalogue::splitLines(bytes)) {
        const std::size_t separator = line.find(catalogue::kArticleSeparator);
        if (separator == std::string_view::npos) continue;
        const std::string title(line.substr(0, separator));
        const auto number = catalogue::findArticleNumber(text, title);
        check(number && number->size() <= 4);
        check(exporting::ArticleIndex(text, 1).find(title) == *number);
        const std::size_t at = catalogue::findArticleLine(text, title);
        check(at != std::string::npos);
        check(catalogue::removeArticleLineAt(std::string(text), at).size() < text.size());
        const std::string renamed =
            catalogue::renameArticleLineAt(std::string(text), at, title.size(), "Other");
        check(text.find("ther#") != std::string::npos ||
              catalogue::findArticleNumber(renamed, "Other") == number);
        break;
    }
}
