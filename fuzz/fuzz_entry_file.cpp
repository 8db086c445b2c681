// Any bytes as an entry file: reading its titles and every edit made on its text.
#include "catalogue/file_text.h"
#include "catalogue/records.h"
#include "export/report_table.h"
#include "fuzz/fuzz_target.h"

void fuzzOne(const std::string& bytes) {
    const auto titles = catalogue::entryTitles(bytes);
    if (!titles) return;
    const std::string text = catalogue::toFileText(bytes);
    // The report takes the entries of a file the program wrote line by line, and searches any
    // other text marker by marker; a last line without a marker changes no lookup but leaves
    // only the search, which must find the same.
    const std::vector<std::string> all = titles->strings();
    const exporting::ReportOptions options{false, true};
    check(exporting::BuildReportTable("L", text, "", all, options, "") ==
          exporting::BuildReportTable("L", text + "x\r\n", "", all, options, ""));
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
