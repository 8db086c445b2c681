#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "list_order/list_order.h"

// Record formats of the list files and the lookups and edits made on their file texts.
// An entry is four lines: "<|?" title, "<|'" type, "<||" discs, "<|*" information.
// An article line is title + "#*\" + a four-character article number.
namespace catalogue {

inline constexpr std::string_view kTitleTag = "<|?";
inline constexpr std::string_view kTypeTag = "<|'";
inline constexpr std::string_view kDiscsTag = "<||";
inline constexpr std::string_view kInfoTag = "<|*";
inline constexpr std::string_view kArticleSeparator = "#*\\";

inline constexpr std::string_view kPlaceholderTitle = "Add an item and delete me!";
inline constexpr std::string_view kPlaceholderList = "Add one & delete me!";
inline constexpr int kMaxEntries = 32767;

struct Entry {
    std::string title;
    std::string type;
    std::string discs;
    std::string information;
};

// The skeleton a new or emptied list gets.
inline constexpr std::string_view kSkeletonEntries =
    "<|?Add an item and delete me!\r\n<|'DELETE ME!\r\n<||DELETE ME!\r\n<|*DELETE ME!\r\n";
inline constexpr std::string_view kSkeletonArticles = "Add an item and delete me!#*\\A001\r\n";
inline constexpr std::string_view kSkeletonCounter = "A#001\r\n";

// File names of a list's files: the list name in the file system's encoding plus the ending.
std::string entryFile(std::string_view list);
std::string articleFile(std::string_view list);
std::string counterFile(std::string_view list);
std::string flagFile(std::string_view list);

// The titles of an entry file's bytes in the list boxes' order: each entry's first line from its
// fourth character on. Nothing when the file does not hold whole entries of four lines.
std::optional<list_order::Items> entryTitles(std::string_view bytes);

// Position of the first title line "<|?" + title + CR in an entry text, ignoring case, that
// starts one of its four-line entries; npos if none.
std::size_t findTitleLine(std::string_view entries, std::string_view title);

// The entry whose title line is the first "<|?" + title + CR (ignoring case); its other fields
// follow from exact searches for the next markers. Nothing when the title line is missing.
std::optional<Entry> findEntry(std::string_view entries, std::string_view title);

// The four lines of an entry, each followed by CR LF.
std::string entryLines(const Entry& entry);

// The entry text with the entry appended at its end.
std::string appendEntry(std::string_view entries, const Entry& entry);

// Where an edit found the entry it replaced or removed: its title line and the three lines
// after it, or up to the end of a text that stops short of them.
struct EntrySpan {
    std::size_t at = 0;
    std::size_t end = 0;
    // The span is the entry's four whole lines: the edit changed that one title and no other.
    bool oneEntry = false;
};

// The entry text with the entry titled `oldTitle` (first match, ignoring case) replaced in place.
// Nothing when no such entry exists. `found`, when given, receives where the entry was.
std::optional<std::string> replaceEntry(std::string_view entries, std::string_view oldTitle,
                                        const Entry& entry, EntrySpan* found = nullptr);

// The entry text without the entry titled `title` (first match, ignoring case). Nothing when
// no such entry exists. `found`, when given, receives where the entry was.
std::optional<std::string> removeEntry(std::string_view entries, std::string_view title,
                                       EntrySpan* found = nullptr);

// Position of the first article line whose text before "#*\" equals the title ignoring case.
std::size_t findArticleLine(std::string_view articles, std::string_view title);

// The four characters after that line's "#*\"; nothing when the title has no line.
std::optional<std::string> findArticleNumber(std::string_view articles, std::string_view title);

// The article line for a title, with CR LF.
std::string articleLine(std::string_view title, std::string_view number);

// Edits of the article text on the line findArticleLine() found at `at`, made in the text itself
// (only what follows the line moves): the title there, `oldSize` bytes, given a new title that
// keeps its number and place; or the line removed (nothing removed for npos) and `appended`
// added at the end.
std::string renameArticleLineAt(std::string&& articles, std::size_t at, std::size_t oldSize,
                                std::string_view newTitle);
std::string removeArticleLineAt(std::string&& articles, std::size_t at,
                                std::string_view appended = {});

// The list index without the first line equal to `name` ignoring case; unchanged when none.
std::string removeIndexLine(std::string_view index, std::string_view name);

// What is wrong with a value for an entry field, or an empty text when it can be stored:
// no CR or LF, and none of the markers that the lookups rely on.
std::string valueProblem(std::string_view value, bool isTitle);

}  // namespace catalogue
