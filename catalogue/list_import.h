#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "catalogue/store.h"

// Bringing a spreadsheet's rows into a list: every row added as the Add button adds an entry,
// all of them in one transaction.
namespace catalogue {

struct ImportResult {
    // Why nothing was imported (no header, no title column, a list that cannot be created);
    // empty when the rows were gone through.
    std::string problem;
    std::string list;  // the list's name as the list index spells it
    bool created = false;
    int added = 0;
    struct Refused {
        long line;
        std::string reason;
    };
    std::vector<Refused> refused;
};

// Adds the rows of CSV file bytes to `list`, creating the list (information column set) when the
// index does not hold it. The header row names the columns, matched ignoring case: title
// (required), type, discs, information; others are ignored. The bytes are UTF-8 when they are
// well-formed UTF-8 (a BOM is skipped), ISO-8859-1 otherwise. A row is refused for what Add
// refuses, with the same words, and for a character outside ISO-8859-1; the others are written
// together, with article numbers handed out in row order. Nothing is written when no row passes.
// Throws CatalogueError when a file cannot be read or written; nothing has changed then.
ImportResult importCsv(Store& store, const std::string& list, std::string_view csvBytes);

}  // namespace catalogue
