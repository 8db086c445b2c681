#include "export/report_table.h"

#include <algorithm>
#include <array>
#include <cstring>
#include <string>

#include "catalogue/file_text.h"
#include "catalogue/latin1.h"
#include "catalogue/records.h"
#include "export/html_page.h"
#include "export/title_index.h"

namespace exporting {

namespace {

using catalogue::kCrLf;
constexpr auto npos = std::string_view::npos;

// The fixed pieces of one of the four layouts. The strings are the report's own drawing.
struct Layout {
    std::size_t nameDashes;  // dashes after ".[name]" are this minus the name's length
    std::string_view columnMarks;
    std::string_view closingWithoutDate;
    std::size_t dateField;  // width of the dashes and the date together
    std::string_view header;
    std::string_view underline;
    std::string_view bottom;
    std::string_view counterStart;
    std::size_t counterField;  // width of the count and its trailing dashes together
    std::string_view counterColumns;
};

constexpr Layout kArticleLayout{
    30,
    "------------------.--------",
    "----------.------.",
    16,
    "|Art#|tiTLE                                        |tYPE              |dISC's|",
    ">----+---------------------------------------------+------------------+------<",
    "'----'---------------------------------------------'------------------'------'",
    "'----'-[total titles:",
    11,
    "------------------'------------------'------'"};

constexpr Layout kArticleInfoLayout{
    30,
    ".------------------.------.",
    "-----------------.",
    16,
    "|Art#|tiTLE                      |tYPE              |dISC's|iNFORMATiOn      |",
    ">----+---------------------------+------------------+------+-----------------<",
    "'----'---------------------------'------------------'------'-----------------'",
    "'----'-[total titles:",
    11,
    "'------------------'------'-----------------'"};

constexpr Layout kTitleLayout{
    44,
    "-.-",
    "------------------.--------.",
    26,
    "| tiTLE                                         | tYPE              | dISC's |",
    ">-----------------------------------------------+-------------------+--------<",
    "'-----------------------------------------------'-------------------'--------'",
    "'-[total titles:",
    12,
    "-------------------'-------------------'--------'"};

constexpr Layout kTitleInfoLayout{
    26,
    ".-------------------.--------.",
    "------------------.",
    17,
    "| tiTLE                      | tYPE              | dISC's | iNFORMATiON      |",
    ">----------------------------+-------------------+--------+------------------<",
    "'----------------------------'-------------------'--------'------------------'",
    "'-[total titles:",
    12,
    "'-------------------'--------'------------------'"};

static_assert(kArticleLayout.header.size() == 78 && kArticleInfoLayout.header.size() == 78 &&
              kTitleLayout.header.size() == 78 && kTitleInfoLayout.header.size() == 78);

const Layout& layoutFor(const ReportOptions& options) {
    if (options.articleNumbers) return options.information ? kArticleInfoLayout : kArticleLayout;
    return options.information ? kTitleInfoLayout : kTitleLayout;
}

std::string dashes(std::size_t total, std::size_t used) {
    return std::string(total > used ? total - used : 0, '-');
}

void topBorder(std::string& out, const Layout& layout, std::string_view listName,
               const ReportOptions& options, std::string_view dateText) {
    const std::string name = firstChars(listName, 26);
    out.append(".[").append(name).append("]");
    out.append(dashes(layout.nameDashes, name.size()));
    out.append(layout.columnMarks);
    if (options.date) {
        out.append(dashes(layout.dateField, dateText.size())).append(dateText).append("-.");
    } else {
        out.append(layout.closingWithoutDate);
    }
    out.append(kCrLf);
}

// Appends the first `cut` characters of `text`, then spaces up to `width` characters.
void appendCell(std::string& out, std::string_view text, std::size_t cut, std::size_t width) {
    text = text.substr(0, std::min(cut, text.size()));
    out.append(text);
    if (text.size() < width) out.append(width - text.size(), ' ');
}

constexpr std::size_t kWhole = npos;

void row(std::string& out, const ReportOptions& options, std::string_view title,
         const Fields& fields, std::string_view articleNumber) {
    // A discs text of up to 6 characters is shown whole, even where it widens the row.
    const std::size_t discsCut = fields.discs.size() > 6 ? 5 : kWhole;
    if (options.articleNumbers) {
        out.append("|");
        appendCell(out, articleNumber, kWhole, 4);
        out.append("|");
        appendCell(out, title, options.information ? 26 : kWhole, options.information ? 27 : 45);
        out.append("|");
        appendCell(out, fields.type, 17, 18);
        out.append("|  ");
        appendCell(out, fields.discs, discsCut, 4);
        if (options.information) {
            out.append("|");
            appendCell(out, fields.information, 16, 17);
        }
    } else {
        out.append("| ");
        appendCell(out, title, options.information ? 26 : kWhole, options.information ? 27 : 46);
        out.append("| ");
        appendCell(out, fields.type, 17, 18);
        out.append("|   ");
        appendCell(out, fields.discs, discsCut, 5);
        if (options.information) {
            out.append("| ");
            appendCell(out, fields.information, 16, 17);
        }
    }
    out.append("|").append(kCrLf);
}

// Every row and separator line of the table is 78 characters and CR LF, unless a text too
// long for its cell widens it.
constexpr std::size_t kLineSize = 80;

// Where the cells of a row stand, and the row with every cell empty: a row whose texts fit
// their cells is that row with the texts copied over its spaces.
struct RowShape {
    std::string blank;
    std::size_t article = 1, title, titleCut, titleWidth, type, discs, discsWidth, info;
};

RowShape shapeFor(const ReportOptions& options) {
    RowShape shape;
    row(shape.blank, options, {}, {}, {});
    const bool art = options.articleNumbers;
    shape.title = art ? 6 : 2;
    shape.titleCut = options.information ? 26 : kWhole;
    shape.titleWidth = options.information ? 27 : art ? 45 : 46;
    shape.type = shape.title + shape.titleWidth + (art ? 1 : 2);
    shape.discs = shape.type + 18 + (art ? 3 : 4);
    shape.discsWidth = art ? 4 : 5;
    shape.info = shape.discs + shape.discsWidth + (art ? 1 : 2);
    return shape;
}

std::string escaped(std::string_view text) {
    std::string out;
    appendEscaped(out, text);
    return out;
}

void put(char* to, std::string_view text, std::size_t size) {
    if (size != 0) std::memcpy(to, text.data(), size);
}

// The row as row() writes it, into the blank row where its texts fit (nearly every row).
void fittedRow(std::string& out, std::string& scratch, const RowShape& shape,
               const ReportOptions& options, std::string_view title, const Fields& fields,
               std::string_view articleNumber) {
    const std::size_t titleSize = std::min(title.size(), shape.titleCut);
    const std::size_t discsSize = fields.discs.size() > 6 ? 5 : fields.discs.size();
    if (titleSize > shape.titleWidth || discsSize > shape.discsWidth || articleNumber.size() > 4) {
        scratch.clear();
        row(scratch, options, title, fields, articleNumber);
        appendText(out, scratch, options.html);
        return;
    }
    // Appended whole into the room reserved for the report, and then written over in place.
    const std::size_t at = out.size();
    out.append(shape.blank);
    char* const cells = out.data() + at;
    put(cells + shape.article, articleNumber, articleNumber.size());
    put(cells + shape.title, title, titleSize);
    put(cells + shape.type, fields.type, std::min<std::size_t>(fields.type.size(), 17));
    put(cells + shape.discs, fields.discs, discsSize);
    if (options.information) {
        put(cells + shape.info, fields.information,
            std::min<std::size_t>(fields.information.size(), 16));
    }
    // The blank row escapes nothing: a row of a page that does is written again, escaped.
    if (options.html && needsEscapes({cells, kLineSize})) {
        scratch.assign(cells, kLineSize);
        out.resize(at);
        appendEscaped(out, scratch);
    }
}

void bottomLine(std::string& out, const Layout& layout, const ReportOptions& options,
                std::size_t count) {
    if (!options.counter) {
        out.append(layout.bottom).append(kCrLf);
        return;
    }
    const std::string shown = catalogue::labelNumber(static_cast<long>(count));
    out.append(layout.counterStart).append(shown).append("]");
    out.append(dashes(layout.counterField, shown.size()));
    out.append(layout.counterColumns).append(kCrLf);
}

}  // namespace

std::string firstChars(std::string_view text, std::size_t width) {
    return std::string(text.substr(0, std::min(width, text.size())));
}

std::string padded(std::string_view text, std::size_t width) {
    std::string out(text);
    if (out.size() < width) out.append(width - out.size(), ' ');
    return out;
}

std::size_t reportTableSize(std::size_t titles, const ReportOptions& options) {
    return (titles * (options.separatorLines ? 2 : 1) + 4) * 82;
}

std::string BuildReportTable(std::string_view listName, std::string_view entryText,
                             std::string_view articleText, const std::vector<std::string>& titles,
                             const ReportOptions& options, std::string_view dateText) {
    std::string out;
    out.reserve(reportTableSize(titles.size(), options));
    appendReportTable(out, listName, entryText, articleText, titles, options, dateText);
    return out;
}

void appendReportTable(std::string& out, std::string_view listName, std::string_view entryText,
                       std::string_view articleText, TitleList titles, const ReportOptions& options,
                       std::string_view dateText) {
    const Layout& layout = layoutFor(options);
    const EntryIndex entries(entryText, titles.size());
    const ArticleIndex articles(options.articleNumbers ? articleText : std::string_view(),
                                titles.size());

    // The lines around the rows, escaped for a page as a whole; the rows are escaped one by one
    // where they need it.
    std::string head;
    topBorder(head, layout, listName, options, dateText);
    head.append(layout.header).append(kCrLf);
    head.append(layout.underline).append(kCrLf);
    appendText(out, head, options.html);
    const RowShape shape = shapeFor(options);
    std::string underline = std::string(layout.underline).append(kCrLf);
    if (options.html) underline = escaped(underline);
    std::string scratch;
    // Each title is looked up a few rows before its row is written, so that the memory its
    // lookups need is fetched meanwhile.
    constexpr std::size_t kAhead = 8;
    std::array<std::size_t, kAhead> hashes{};
    auto fetch = [&](std::size_t i) {
        if (i >= titles.size()) return;
        const std::size_t hash = titleHash(titles[i]);
        hashes[i % kAhead] = hash;
        entries.prefetch(hash);
        if (options.articleNumbers) articles.prefetch(hash);
    };
    for (std::size_t i = 0; i < kAhead; ++i) fetch(i);
    for (std::size_t i = 0; i < titles.size(); ++i) {
        const std::string_view title = titles[i];
        const std::size_t hash = hashes[i % kAhead];
        fetch(i + kAhead);
        fittedRow(out, scratch, shape, options, title, entries.find(title, hash),
                  options.articleNumbers ? articles.find(title, hash) : std::string_view());
        if (options.separatorLines && i + 1 < titles.size()) out.append(underline);
    }
    std::string bottom;
    bottomLine(bottom, layout, options, titles.size());
    appendText(out, bottom, options.html);
}

}  // namespace exporting
