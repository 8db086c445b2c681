#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "catalogue/store.h"

// How the catalogue's Latin-1 names become the file system's bytes. Names of files are UTF-8
// whatever the locale, the same rule the window toolkit follows, so one data folder reads alike
// under every locale and copies cleanly to any volume or share.
namespace catalogue {

// The file-system bytes of a Latin-1 name: its UTF-8 encoding (ASCII stays as it is).
std::string fileSystemName(std::string_view latin1);

// The Latin-1 text of file-system bytes: nothing when they are not UTF-8 or hold a character
// beyond Latin-1.
std::optional<std::string> latin1Name(std::string_view bytes);

// File-system bytes as a message can show them (Latin-1): decoded where possible, otherwise the
// bytes themselves.
std::string shownName(std::string_view bytes);

// The endings of a list's files kept in the catalogue folder.
inline constexpr std::string_view kListFileEndings[] = {".dat", ".art", ".arn", ".inf", ".top"};

// Renames the files of `lists` that an earlier build named with the Latin-1 bytes of the list
// name to their file-system names, all in one commit. A file is left alone when a file of the
// new name is already there. Returns how many files were renamed; throws CatalogueError when the
// commit fails, in which case nothing was renamed.
std::size_t renameLegacyListFiles(Store& store, const std::vector<std::string>& lists);

}  // namespace catalogue
