#include "export/title_index.h"

#include <algorithm>

#include "catalogue/byte_scan.h"
#include "catalogue/latin1.h"
#include "catalogue/records.h"

namespace exporting {

namespace {

constexpr auto npos = std::string_view::npos;

// Whether the three bytes of a marker or separator stand at `at`.
[[gnu::always_inline]] inline bool hasAt(std::string_view text, std::size_t at,
                                         std::string_view tag) {
    return text.size() - at >= 3 && text[at] == tag[0] && text[at + 1] == tag[1] &&
           text[at + 2] == tag[2];
}

// Where the line from `at` ends, at its CR. Npos unless the line ends in CR LF and holds no
// marker of its own: then its entry is not a plain one.
[[gnu::always_inline]] inline std::size_t plainLineEnd(std::string_view text, std::size_t at) {
    for (;;) {
        at = catalogue::findAnyOf<'\r', '<'>(text, at);
        if (at + 1 >= text.size()) return npos;
        if (text[at] == '\r') return text[at + 1] == '\n' ? at : npos;
        // Every marker is "<|" and one of four bytes; a "<" of anything else is only text.
        if (text[at + 1] == '|' && at + 2 < text.size() &&
            std::string_view("?'|*").find(text[at + 2]) != npos) {
            return npos;
        }
        ++at;
    }
}

// The line at `at` when it is a plain one marked `Tag`: its value, and `at` moves past it.
template <const std::string_view& Tag>
[[gnu::always_inline]] inline bool plainLine(std::string_view text, std::size_t& at,
                                             std::string_view& value) {
    if (!hasAt(text, at, Tag)) return false;
    const std::size_t end = plainLineEnd(text, at + 3);
    if (end == npos) return false;
    value = std::string_view(text.data() + at + 3, end - at - 3);
    at = end + 2;
    return true;
}

}  // namespace

bool needsEscapes(std::string_view text) {
    return catalogue::findAnyOf<'&', '<', '>'>(text) != text.size();
}

EntryIndex::EntryIndex(std::string_view text, std::size_t expected)
    : text_(text), titles_(expected) {
    if (!indexPlainEntries()) {
        titles_ = FlatTitleMap<Fields, sameTitle>(expected);
        indexMarkedTitles();
    }
}

// A text of plain entries (the program writes no other) is indexed in one walk: each entry is
// four lines, each line starts with its marker, ends in CR LF and holds no other marker. There
// every title line is a line starting an entry, and each field is the line after the one
// before, which is what the search for the markers finds. False for any other text.
bool EntryIndex::indexPlainEntries() {
    using catalogue::kDiscsTag, catalogue::kInfoTag, catalogue::kTitleTag, catalogue::kTypeTag;
    const std::string_view text = text_;
    for (std::size_t at = 0; at < text.size();) {
        std::string_view title;
        Fields fields;
        if (!plainLine<kTitleTag>(text, at, title) || !plainLine<kTypeTag>(text, at, fields.type) ||
            !plainLine<kDiscsTag>(text, at, fields.discs) ||
            !plainLine<kInfoTag>(text, at, fields.information)) {
            return false;
        }
        titles_.putFirst(title, fields);
    }
    return true;
}

// Any other text: every title marker starts a title up to its CR, and each field is searched.
void EntryIndex::indexMarkedTitles() {
    for (std::size_t at = text_.find(catalogue::kTitleTag); at != npos;
         at = text_.find(catalogue::kTitleTag, at + 1)) {
        const std::size_t start = at + catalogue::kTitleTag.size();
        const std::size_t cr = text_.find('\r', start);
        if (cr == npos) break;      // a title line needs its CR
        std::size_t from = at + 1;  // past the title's own marker, which is none of the others
        Fields fields;
        fields.type = fieldAfter(catalogue::kTypeTag, 0, from);
        fields.discs = fieldAfter(catalogue::kDiscsTag, 1, from);
        fields.information = fieldAfter(catalogue::kInfoTag, 2, from);
        titles_.putFirst(text_.substr(start, cr - start), fields);
    }
}

// The text after the first `tag` at or after `from`, up to the next CR; `from` moves to that
// CR. Empty when no such marker follows.
std::string_view EntryIndex::fieldAfter(std::string_view tag, std::size_t kind,
                                        std::size_t& from) const {
    // Every marker starts with "<": when the first "<" from here starts this one, it is the
    // first. Otherwise the marker's positions are searched.
    std::size_t at = text_.find('<', from);
    if (at == npos) return {};
    if (text_.compare(at, tag.size(), tag) != 0) {
        const std::vector<std::size_t>& positions = markers(kind, tag);
        const auto next = std::lower_bound(positions.begin(), positions.end(), from);
        if (next == positions.end()) return {};
        at = *next;
    }
    const std::size_t start = at + tag.size();
    std::size_t cr = text_.find('\r', start);
    if (cr == npos) cr = text_.size();
    from = cr;
    return text_.substr(start, cr - start);
}

// Where every `tag` stands in the text, found on first need.
const std::vector<std::size_t>& EntryIndex::markers(std::size_t kind, std::string_view tag) const {
    std::optional<std::vector<std::size_t>>& positions = markers_[kind];
    if (!positions) {
        positions.emplace();
        for (std::size_t at = text_.find(tag); at != npos; at = text_.find(tag, at + 1)) {
            positions->push_back(at);
        }
    }
    return *positions;
}

// Lines are found as the catalogue's line rule finds them: a line ends at a CR, an LF right
// after it is skipped, and the last one may end with the text. The stops of one walk are the
// separators' first bytes and the CRs.
ArticleIndex::ArticleIndex(std::string_view text, std::size_t expected) : numbers_(expected) {
    const std::string_view separator = catalogue::kArticleSeparator;
    std::size_t line = 0;
    for (std::size_t at = catalogue::findAnyOf<'#', '\r'>(text); at < text.size();) {
        if (text[at] == '\r') {
            at += at + 1 < text.size() && text[at + 1] == '\n' ? 2 : 1;
            line = at;
        } else if (hasAt(text, at, separator)) {
            const std::size_t numberAt = at + separator.size();
            if (numberAt == text.size()) break;  // nothing at all follows the separator
            // The number is the line's next four characters, or as many as it still has.
            const std::size_t next = catalogue::findAnyOf<'#', '\r'>(text, numberAt);
            std::size_t size = std::min<std::size_t>(next - numberAt, 4);
            if (size < 4 && next < text.size() && text[next] == '#') {
                while (size < 4 && numberAt + size < text.size() && text[numberAt + size] != '\r')
                    ++size;
            }
            numbers_.putFirst(text.substr(line, at - line), text.substr(numberAt, size));
            at = next;
            continue;
        } else {
            ++at;
        }
        at = catalogue::findAnyOf<'#', '\r'>(text, at);
    }
}

}  // namespace exporting
