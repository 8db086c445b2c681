#include "export/title_index.h"

#include <algorithm>
#include <bit>

#include "catalogue/byte_scan.h"
#include "catalogue/file_text.h"
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
    : text_(text), titles_(text, expected) {
    plain_ = indexPlainEntries();
    if (!plain_) {
        titles_ = PlaceMap<TitleKey>(text, expected);
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
        const std::size_t marker = at;
        std::string_view title, field;
        if (!plainLine<kTitleTag>(text, at, title) || !plainLine<kTypeTag>(text, at, field) ||
            !plainLine<kDiscsTag>(text, at, field) || !plainLine<kInfoTag>(text, at, field)) {
            return false;
        }
        titles_.putFirst(title, marker);
    }
    return true;
}

// Any other text: every title marker starts a title up to its CR; the fields are searched for
// when the title is looked up.
void EntryIndex::indexMarkedTitles() {
    for (std::size_t at = text_.find(catalogue::kTitleTag); at != npos;
         at = text_.find(catalogue::kTitleTag, at + 1)) {
        const std::size_t start = at + catalogue::kTitleTag.size();
        const std::size_t cr = text_.find('\r', start);
        if (cr == npos) break;  // a title line needs its CR
        titles_.putFirst(text_.substr(start, cr - start), at);
    }
}

std::string_view EntryIndex::TitleKey::at(std::string_view text, std::size_t marker) {
    const std::size_t start = marker + 3;
    return text.substr(start, text.find('\r', start) - start);
}

Fields EntryIndex::find(std::string_view title, std::size_t hash) const {
    // A title holding a CR is none of the titles, which end at their line's CR.
    if (catalogue::findAnyOf<'\r'>(title) != title.size()) return {};
    const std::size_t marker = titles_.find(title, hash);
    if (marker == npos) return {};
    if (plain_) return plainFields(marker + 3 + title.size() + 2);
    std::size_t from = marker + 1;  // past the title's own marker, which is none of the others
    Fields fields;
    fields.type = fieldAfter(catalogue::kTypeTag, 0, from);
    fields.discs = fieldAfter(catalogue::kDiscsTag, 1, from);
    fields.information = fieldAfter(catalogue::kInfoTag, 2, from);
    return fields;
}

// The three lines of a plain entry from its type line on, without their markers.
Fields EntryIndex::plainFields(std::size_t typeLine) const {
    std::size_t ends[3];
    std::size_t found = 0;
    // Their CRs mostly stand within the next 64 bytes, all found in one look.
    if (text_.size() - typeLine >= 64) {
        for (std::uint64_t crs = catalogue::stopBits64<'\r'>(text_.data() + typeLine);
             found < 3 && crs != 0; crs &= crs - 1) {
            ends[found++] = typeLine + static_cast<std::size_t>(std::countr_zero(crs));
        }
    }
    for (std::size_t from = found == 0 ? typeLine : ends[found - 1] + 2; found < 3; ++found) {
        ends[found] = catalogue::findAnyOf<'\r'>(text_, from + 3);
        from = ends[found] + 2;
    }
    const auto line = [this](std::size_t start, std::size_t end) {
        return std::string_view(text_.data() + start + 3, end - start - 3);
    };
    return {line(typeLine, ends[0]), line(ends[0] + 2, ends[1]), line(ends[1] + 2, ends[2])};
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
ArticleIndex::ArticleIndex(std::string_view text, std::size_t expected)
    : text_(text), numbers_(text, expected) {
    const std::string_view separator = catalogue::kArticleSeparator;
    std::size_t line = 0;
    for (std::size_t at = catalogue::findAnyOf<'#', '\r'>(text); at < text.size();) {
        if (text[at] == '\r') {
            at += at + 1 < text.size() && text[at + 1] == '\n' ? 2 : 1;
            line = at;
        } else if (hasAt(text, at, separator)) {
            // Nothing at all after the separator ends the text, and the walk.
            if (at + separator.size() == text.size()) break;
            numbers_.putFirst(text.substr(line, at - line), at);
            at += separator.size();
        } else {
            ++at;
        }
        at = catalogue::findAnyOf<'#', '\r'>(text, at);
    }
}

std::string_view ArticleIndex::find(std::string_view title, std::size_t hash) const {
    // A title holding a CR is none of the titles, which end before their line's CR.
    if (catalogue::findAnyOf<'\r'>(title) != title.size()) return {};
    const std::size_t separator = numbers_.find(title, hash);
    if (separator == npos) return {};
    // The number is the line's next four characters, or as many as it still has.
    const std::size_t start = separator + catalogue::kArticleSeparator.size();
    std::size_t size = 0;
    while (size < 4 && start + size < text_.size() && text_[start + size] != '\r') ++size;
    return text_.substr(start, size);
}

std::string_view ArticleIndex::LineKey::at(std::string_view text, std::size_t separator) {
    std::size_t start = separator;
    while (!catalogue::startsLine(text, start)) --start;
    return text.substr(start, separator - start);
}

// `title` (without a CR) stands before the separator from the start of its line, ignoring case.
bool ArticleIndex::LineKey::holds(std::string_view text, std::size_t separator,
                                  std::string_view title) {
    if (separator < title.size() || !catalogue::startsLine(text, separator - title.size()))
        return false;
    const std::string_view there = text.substr(separator - title.size(), title.size());
    return sameTitle(there, title) || catalogue::equalsIgnoreCase(there, title);
}

}  // namespace exporting
