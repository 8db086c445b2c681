#include "export/list_report.h"

#include "catalogue/byte_scan.h"
#include "catalogue/catalogue_error.h"
#include "catalogue/csv.h"
#include "catalogue/file_names.h"
#include "catalogue/file_text.h"
#include "catalogue/latin1.h"
#include "catalogue/records.h"
#include "catalogue/sys.h"
#include "export/form_export.h"
#include "export/html_page.h"
#include "export/last_added.h"
#include "export/report_table.h"
#include "export/title_index.h"

namespace exporting {

list_order::Items listTitles(catalogue::Store& store, const std::string& list) {
    const std::string file = catalogue::entryFile(list);
    std::optional<list_order::Items> titles = catalogue::entryTitles(store.readBytes(file));
    if (!titles) throw catalogue::CatalogueError(file, "the file ends inside an entry");
    return std::move(*titles);
}

ListReport buildListReport(catalogue::Store& store, const std::string& list, TitleList titles,
                           const ReportChoices& choices, std::string_view date) {
    catalogue::clearUpperVectorHalves();  // the scans of the list's texts below
    ListReport result;
    // Lists made by older copies may have no flag file; the main window shows them with the
    // information column, and so does the report.
    const std::string flagFile = catalogue::flagFile(list);
    result.flag = store.exists(flagFile) ? store.readNumber(flagFile) : std::optional<long>(1);
    result.information = result.flag == 1 || (result.flag != 0 && !choices.noInformation);

    const std::string entries = store.readText(catalogue::entryFile(list));
    const std::string articles =
        choices.articleNumbers ? store.readText(catalogue::articleFile(list)) : std::string();

    ReportOptions options;
    options.articleNumbers = choices.articleNumbers;
    options.information = result.information;
    options.date = choices.date;
    options.separatorLines = choices.separatorLines;
    options.counter = choices.counter;
    options.html = choices.html;

    LastAddedRequest request;
    request.include = choices.lastAdded;
    request.amountText = choices.amountText;
    request.position = choices.position;
    request.information = options.information;
    request.titleCount = titles.size();
    const std::optional<std::string> section =
        lastAddedFor(entries, request, result.lastAddedRefused);
    const bool sectionFirst = section && choices.position == "Top";

    // The top text is optional: a file that is missing or cannot be read is simply left out.
    std::string top;
    try {
        top = store.readTextIfExists(catalogue::fileSystemName(list) + ".top").value_or("");
    } catch (const catalogue::CatalogueError&) {
    }

    // One buffer, in the report's order: the section placed on top (and an empty line), the top
    // text, the table, the section placed below, the credit line and the file's end; a page
    // around them all, escaped as they are written.
    std::string& out = result.text;
    const bool html = choices.html;
    std::size_t size = (section ? section->size() : 0) + top.size() +
                       reportTableSize(titles.size(), options) + 128;
    // An escape adds at most four bytes; the table's own drawing escapes two bytes of a line.
    if (html) size += size / 8 + 5 * list.size() + 256;
    catalogue::reserveBacked(out, size);
    if (html) appendPageStart(out, list);
    std::string pieces;
    if (sectionFirst) pieces.append(*section).append(catalogue::kCrLf);
    pieces.append(top);
    appendText(out, pieces, html);
    appendReportTable(out, list, entries, articles, titles, options,
                      choices.date ? date : std::string_view());
    pieces.clear();
    if (section && !sectionFirst) pieces.append(*section);
    pieces.append(36, ' ').append(kCreditText).append(catalogue::kCrLf);
    appendText(out, pieces, html);
    html ? appendPageEnd(out) : void(out.append(catalogue::kCrLf));
    return result;
}

std::string listCsv(catalogue::Store& store, const std::string& list) {
    catalogue::clearUpperVectorHalves();  // the scans of the list's texts below
    const list_order::Items titles = listTitles(store, list);
    const std::string entryText = store.readText(catalogue::entryFile(list));
    const std::string articleText = store.readText(catalogue::articleFile(list));
    const EntryIndex entries(entryText, titles.size());
    const ArticleIndex articles(articleText, titles.size());
    std::string csv =
        catalogue::csvRow({"title", "type", "discs", "information", "article number"});
    csv.reserve(entryText.size() + articleText.size());
    for (std::size_t i = 0; i < titles.size(); ++i) {
        const std::string_view title = titles[i];
        const Fields fields = entries.find(title);
        csv += catalogue::latin1ToUtf8(catalogue::csvRow(
            {std::string(title), std::string(fields.type), std::string(fields.discs),
             std::string(fields.information), std::string(articles.find(title))}));
    }
    return csv;
}

}  // namespace exporting
