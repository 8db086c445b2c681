#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "catalogue/article_numbers.h"
#include "catalogue/records.h"
#include "catalogue/store.h"

// What adding an entry and creating a list refuse, in one place, so that every way into the
// catalogue (the windows, an import) refuses the same things with the same words.
namespace catalogue {

inline constexpr const char* kDuplicateTitle = "Title already exist, change name and try again!";
inline constexpr const char* kListFull = "This list is full: a list holds at most 32767 titles.";
inline constexpr const char* kCatalogueFull =
    "The catalogue is full: it holds at most 32767 lists.";
inline constexpr const char* kNameInUse = "A list with that name already exist!";
inline constexpr const char* kBadName = "Ya can't use /\\:?*<>\" in the name!";
// Names a list may not take: the base names of the program's own files, and "print".
inline constexpr const char* kReservedNames = "export|print|pemla|information|type|";
inline constexpr int kMaxNameLength = 26;
inline constexpr const char* kIndexFile = "pemla.dat";

// Why an entry cannot be stored as it is (no title, a line break or a record marker in a field),
// or an empty text when it can.
std::string entryRefusal(const Entry& entry);

// Whether a title may join a list whose entry text already holds it: only the title of exactly
// one space may stand twice.
bool isDuplicateTitle(std::string_view entries, std::string_view title);

// The next article number for a title's first character and the counter text after it, or, when
// the letter's numbers are used up, nothing and the refusal in `refusal`. Throws CatalogueError
// naming `counterFile` when the letter's record is damaged.
std::optional<ArticleNumberResult> handOutNumber(std::string_view counterText,
                                                 const std::string& counterFile,
                                                 char firstCharacter, std::string& refusal);

struct NewListCheck {
    // Empty when the name may be created; else kBadName, kNameInUse or kCatalogueFull.
    std::string refusal;
    // The list index's text as read for the test (empty after a refused probe).
    std::string index;
};

// What "Create" says about a new list name: a name the folder cannot take as a file name (tried
// out with a probe file, before anything is read), one already listed (ignoring case, also the
// end of a listed name), a reserved name or a trailing part of one, the empty name, and a full
// index. Throws CatalogueError when the list index cannot be read.
NewListCheck checkNewListName(Store& store, const std::string& name);

}  // namespace catalogue
