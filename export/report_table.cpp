#include "export/report_table.h"

#include <algorithm>
#include <string>
#include <unordered_map>

#include "catalogue/file_text.h"
#include "catalogue/latin1.h"
#include "catalogue/records.h"

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

struct Fields {
    std::string_view type;
    std::string_view discs;
    std::string_view information;
};

// Every title line of an entry text, looked up by its exact title; the first one wins, as a
// search from the start of the text would find it. The other fields are found by the positions
// of their markers, so a title costs a few binary searches however long the text is.
class EntryIndex {
  public:
    explicit EntryIndex(std::string_view text) : text_(text) {
        // An entry takes at least twenty bytes; reserving for that many avoids rehashing.
        titles_.reserve(text.size() / 20 + 1);
        for (std::size_t at = text.find(catalogue::kTitleTag); at != npos;
             at = text.find(catalogue::kTitleTag, at + 1)) {
            const std::size_t start = at + catalogue::kTitleTag.size();
            const std::size_t cr = text.find('\r', start);
            if (cr == npos) break;  // a title line needs its CR
            titles_.emplace(text.substr(start, cr - start), at);
        }
        collect(catalogue::kTypeTag, types_);
        collect(catalogue::kDiscsTag, discs_);
        collect(catalogue::kInfoTag, infos_);
    }

    Fields find(std::string_view title) const {
        const auto hit = titles_.find(title);
        if (hit == titles_.end()) return {};
        std::size_t from = hit->second;
        Fields fields;
        fields.type = fieldAfter(types_, from);
        fields.discs = fieldAfter(discs_, from);
        fields.information = fieldAfter(infos_, from);
        return fields;
    }

  private:
    void collect(std::string_view tag, std::vector<std::size_t>& positions) const {
        for (std::size_t at = text_.find(tag); at != npos; at = text_.find(tag, at + 1)) {
            positions.push_back(at);
        }
    }

    // The text after the first marker at or after `from`, up to the next CR; `from` moves to
    // that CR. Empty when no marker follows.
    std::string_view fieldAfter(const std::vector<std::size_t>& positions,
                                std::size_t& from) const {
        const auto at = std::lower_bound(positions.begin(), positions.end(), from);
        if (at == positions.end()) return {};
        const std::size_t start = *at + 3;
        std::size_t cr = text_.find('\r', start);
        if (cr == npos) cr = text_.size();
        from = cr;
        return text_.substr(start, cr - start);
    }

    std::string_view text_;
    std::unordered_map<std::string_view, std::size_t> titles_;
    std::vector<std::size_t> types_;
    std::vector<std::size_t> discs_;
    std::vector<std::size_t> infos_;
};

// Hashing and comparing titles ignoring Latin-1 case, without building folded copies.
struct FoldedHash {
    std::size_t operator()(std::string_view text) const {
        std::size_t h = 14695981039346656037ull;
        for (char c : text) {
            h = (h ^ catalogue::foldByte(static_cast<unsigned char>(c))) * 1099511628211ull;
        }
        return h;
    }
};
struct FoldedEqual {
    bool operator()(std::string_view a, std::string_view b) const {
        return catalogue::equalsIgnoreCase(a, b);
    }
};

// Every article line of an article text by its title ignoring case; the first line wins. A line
// is "title#*\number"; each "#*\" of a line could end the title, as the line-by-line search of
// the catalogue would allow.
class ArticleIndex {
  public:
    explicit ArticleIndex(std::string_view text) {
        numbers_.reserve(text.size() / 9 + 1);  // an article line takes at least nine bytes
        std::size_t start = 0;
        while (start < text.size()) {
            std::size_t cr = text.find('\r', start);
            std::size_t end = cr == npos ? text.size() : cr + 1;
            if (cr == npos) cr = text.size();
            if (end < text.size() && text[end] == '\n') ++end;
            const std::string_view line = text.substr(start, cr - start);
            for (std::size_t at = line.find(catalogue::kArticleSeparator); at != npos;
                 at = line.find(catalogue::kArticleSeparator, at + 1)) {
                const std::size_t numberAt = at + catalogue::kArticleSeparator.size();
                if (start + numberAt >= end) break;  // nothing at all follows the separator
                numbers_.emplace(line.substr(0, at), line.substr(numberAt, 4));
            }
            start = end;
        }
    }

    std::string_view find(std::string_view title) const {
        const auto hit = numbers_.find(title);
        return hit == numbers_.end() ? std::string_view() : hit->second;
    }

  private:
    std::unordered_map<std::string_view, std::string_view, FoldedHash, FoldedEqual> numbers_;
};

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

std::string BuildReportTable(std::string_view listName, std::string_view entryText,
                             std::string_view articleText, const std::vector<std::string>& titles,
                             const ReportOptions& options, std::string_view dateText) {
    const Layout& layout = layoutFor(options);
    const EntryIndex entries(entryText);
    const ArticleIndex articles(options.articleNumbers ? articleText : std::string_view());

    std::string out;
    out.reserve((titles.size() * (options.separatorLines ? 2 : 1) + 4) * 82);
    topBorder(out, layout, listName, options, dateText);
    out.append(layout.header).append(kCrLf);
    out.append(layout.underline).append(kCrLf);
    for (std::size_t i = 0; i < titles.size(); ++i) {
        const std::string_view title = titles[i];
        row(out, options, title, entries.find(title),
            options.articleNumbers ? articles.find(title) : std::string_view());
        if (options.separatorLines && i + 1 < titles.size()) {
            out.append(layout.underline).append(kCrLf);
        }
    }
    bottomLine(out, layout, options, titles.size());
    return out;
}

}  // namespace exporting
