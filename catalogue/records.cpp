#include "catalogue/records.h"

#include <algorithm>

#include "catalogue/byte_scan.h"
#include "catalogue/file_names.h"
#include "catalogue/file_text.h"
#include "catalogue/latin1.h"

namespace catalogue {

namespace {

constexpr auto npos = std::string_view::npos;

// The text after `tag` (found at or after `from`) up to the next CR; moves `from` to that CR.
std::optional<std::string> fieldAfter(std::string_view text, std::string_view tag,
                                      std::size_t& from) {
    const std::size_t at = text.find(tag, from);
    if (at == npos) return std::nullopt;
    const std::size_t start = at + tag.size();
    const std::size_t cr = text.find('\r', start);
    if (cr == npos) return std::nullopt;
    from = cr;
    return std::string(text.substr(start, cr - start));
}

// End of the line starting at `at`, past its CR LF. Lines end at CR only: a lone LF is data.
std::size_t lineEnd(std::string_view text, std::size_t at) {
    return lineAt(text, at).next;
}

// The entry whose title line starts at `at`: its four lines, or up to the end of a text that
// stops short of them.
EntrySpan spanOf(std::string_view text, std::size_t at) {
    EntrySpan span{at, at, false};
    int lines = 0;
    while (lines < 4 && span.end < text.size()) {
        const std::size_t cr = text.find('\r', span.end);
        if (cr == npos) {
            span.end = text.size();
            break;
        }
        span.end = cr + 1;
        if (span.end < text.size() && text[span.end] == '\n') ++span.end;
        ++lines;
    }
    span.oneEntry = lines == 4;
    return span;
}

}  // namespace

std::string entryFile(std::string_view list) {
    return fileSystemName(list) + ".dat";
}
std::string articleFile(std::string_view list) {
    return fileSystemName(list) + ".art";
}
std::string counterFile(std::string_view list) {
    return fileSystemName(list) + ".arn";
}
std::string flagFile(std::string_view list) {
    return fileSystemName(list) + ".inf";
}

std::optional<list_order::Items> entryTitles(std::string_view bytes) {
    clearUpperVectorHalves();  // the scans of the entry file below
    // The titles go into one buffer, not one string each: a long list opens that much faster.
    std::string titles;
    // Room enough not to move them while they grow: a title is at most the larger half of its
    // entry, and an entry takes some 50 bytes or more. What stays unused is never touched.
    titles.reserve(bytes.size() / 2);
    std::vector<list_order::Items::Place> places;
    places.reserve(bytes.size() / 32 + 1);
    // Lines as lineAt() splits them, with their ends found sixteen bytes at a time.
    std::size_t lines = 0;
    for (std::size_t at = 0; at < bytes.size(); ++lines) {
        const std::size_t cr = findAnyOf<'\r'>(bytes, at);
        if (lines % 4 == 0) {
            const std::size_t from = std::min(at + 3, cr);
            places.push_back({titles.size(), cr - from});
            titles.append(bytes, from, cr - from);
        }
        at = cr + 1;
        if (at < bytes.size() && bytes[at] == '\n') ++at;
    }
    if (lines % 4 != 0) return std::nullopt;
    return list_order::Items(std::move(titles), std::move(places));
}

std::size_t findTitleLine(std::string_view entries, std::string_view title) {
    std::string needle;
    needle.reserve(title.size() + 4);
    needle.append(kTitleTag).append(title).push_back('\r');
    // Only a line that starts one of the four-line entries is a title line: a value of a file
    // from elsewhere may hold the title tag, and taking it for an entry would cut the file
    // across entries. Lines are counted only when a match turns up.
    std::size_t counted = 0;
    std::size_t lines = 0;
    for (std::size_t at = findIgnoreCase(entries, needle); at != npos;
         at = findIgnoreCase(entries, needle, at + 1)) {
        if (!startsLine(entries, at)) continue;
        lines += countOf<'\r'>(entries, counted, at);
        counted = at;
        if (lines % 4 == 0) return at;
    }
    return npos;
}

std::optional<Entry> findEntry(std::string_view entries, std::string_view title) {
    std::size_t pos = findTitleLine(entries, title);
    if (pos == npos) return std::nullopt;
    Entry entry;
    entry.title = std::string(entries.substr(pos + kTitleTag.size(), title.size()));
    auto type = fieldAfter(entries, kTypeTag, pos);
    if (!type) return std::nullopt;
    auto discs = fieldAfter(entries, kDiscsTag, pos);
    if (!discs) return std::nullopt;
    auto info = fieldAfter(entries, kInfoTag, pos);
    if (!info) return std::nullopt;
    entry.type = std::move(*type);
    entry.discs = std::move(*discs);
    entry.information = std::move(*info);
    return entry;
}

std::string entryLines(const Entry& entry) {
    std::string lines;
    lines.reserve(entry.title.size() + entry.type.size() + entry.discs.size() +
                  entry.information.size() + 20);
    lines.append(kTitleTag).append(entry.title).append(kCrLf);
    lines.append(kTypeTag).append(entry.type).append(kCrLf);
    lines.append(kDiscsTag).append(entry.discs).append(kCrLf);
    lines.append(kInfoTag).append(entry.information).append(kCrLf);
    return lines;
}

std::string appendEntry(std::string_view entries, const Entry& entry) {
    std::string text;
    text.reserve(entries.size() + kCrLf.size() + entry.title.size() + entry.type.size() +
                 entry.discs.size() + entry.information.size() + 20);
    text.append(entries);
    text = forWriting(std::move(text));
    text.append(entryLines(entry));
    return text;
}

std::optional<std::string> replaceEntry(std::string_view entries, std::string_view oldTitle,
                                        const Entry& entry, EntrySpan* found) {
    const std::size_t at = findTitleLine(entries, oldTitle);
    if (at == npos) return std::nullopt;
    const EntrySpan span = spanOf(entries, at);
    const std::size_t end = span.end;
    if (found != nullptr) *found = span;
    std::string text;
    text.reserve(entries.size() + entry.title.size() + 64);
    text.append(entries.substr(0, at));
    text.append(entryLines(entry));
    text.append(entries.substr(end));
    return text;
}

std::optional<std::string> removeEntry(std::string_view entries, std::string_view title,
                                       EntrySpan* found) {
    const std::size_t at = findTitleLine(entries, title);
    if (at == npos) return std::nullopt;
    const EntrySpan span = spanOf(entries, at);
    const std::size_t end = span.end;
    if (found != nullptr) *found = span;
    std::string text;
    text.reserve(entries.size());
    text.append(entries.substr(0, at));
    text.append(entries.substr(end));
    return text;
}

std::size_t findArticleLine(std::string_view articles, std::string_view title) {
    // A line ends at its CR, so a title holding one starts no line.
    if (title.find('\r') != npos) return npos;
    std::string needle;
    needle.reserve(title.size() + kArticleSeparator.size());
    needle.append(title).append(kArticleSeparator);
    // The title and separator are searched for as one text, which skips most of the file; a
    // match counts where a line starts and something follows it on that line (its CR at least).
    for (std::size_t at = findIgnoreCase(articles, needle); at != npos;
         at = findIgnoreCase(articles, needle, at + 1)) {
        if (at + needle.size() >= articles.size()) return npos;
        if (at == 0 || (articles[at - 1] == '\r' && articles[at] != '\n') ||
            (articles[at - 1] == '\n' && at >= 2 && articles[at - 2] == '\r')) {
            return at;
        }
    }
    return npos;
}

std::optional<std::string> findArticleNumber(std::string_view articles, std::string_view title) {
    const std::size_t at = findArticleLine(articles, title);
    if (at == npos) return std::nullopt;
    const std::size_t numberAt = at + title.size() + kArticleSeparator.size();
    const std::size_t cr = articles.find('\r', numberAt);
    const std::size_t stop = cr == npos ? articles.size() : cr;
    return std::string(articles.substr(numberAt, std::min<std::size_t>(4, stop - numberAt)));
}

std::string articleLine(std::string_view title, std::string_view number) {
    std::string line;
    line.reserve(title.size() + number.size() + 5);
    line.append(title).append(kArticleSeparator).append(number).append(kCrLf);
    return line;
}

std::string renameArticleLineAt(std::string&& articles, std::size_t at, std::size_t oldSize,
                                std::string_view newTitle) {
    articles.replace(at, oldSize, newTitle);
    return std::move(articles);
}

std::string removeArticleLineAt(std::string&& articles, std::size_t at, std::string_view appended) {
    if (at != npos) articles.erase(at, lineEnd(articles, at) - at);
    articles.append(appended);
    return std::move(articles);
}

std::string removeIndexLine(std::string_view index, std::string_view name) {
    std::size_t start = 0;
    while (start < index.size()) {
        const std::size_t end = lineEnd(index, start);
        std::string_view line = index.substr(start, end - start);
        if (line.ends_with(kCrLf)) line.remove_suffix(2);
        if (equalsIgnoreCase(line, name)) {
            std::string text(index.substr(0, start));
            text.append(index.substr(end));
            return text;
        }
        start = end;
    }
    return std::string(index);
}

std::string valueProblem(std::string_view value, bool isTitle) {
    if (value.find_first_of("\r\n") != npos) return "a line break";
    for (std::string_view tag : {kTitleTag, kTypeTag, kDiscsTag, kInfoTag}) {
        if (value.find(tag) != npos) return "\"" + std::string(tag) + "\"";
    }
    if (isTitle && value.find(kArticleSeparator) != npos) {
        return "\"" + std::string(kArticleSeparator) + "\"";
    }
    return {};
}

}  // namespace catalogue
