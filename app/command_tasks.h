#pragma once

#include <iosfwd>
#include <string>

#include "app/command_line.h"

// The commands that work on the catalogue without any window: export and import.
namespace app {

// Makes the command's files absolute against the current folder, so they keep naming the same
// files once the program has entered its data folder.
void resolveCommandFiles(CommandLine& line);

// `pemla export`: writes the list's text report, HTML page (--html) or CSV (--csv) to the output
// file (atomically) or to `out`. The report takes the export dialog's settings from export.dat
// besides --html and --article-numbers. Returns 0, or 1 after a line on `err` naming what failed
// (no such list, a list file that cannot be read, an output that cannot be written).
int exportCommand(const CommandLine& line, const std::string& folder, std::ostream& out,
                  std::ostream& err);

// `pemla import`: adds the CSV file's rows to the list in one transaction. Prints how many rows
// were added on `out` and each refused row with its line and reason on `err`. Returns 0 when every
// row was added, 3 when some were refused and the others added, 1 when nothing was written.
int importCommand(const CommandLine& line, const std::string& folder, std::ostream& out,
                  std::ostream& err);

}  // namespace app
