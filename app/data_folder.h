#pragma once

#include <functional>
#include <optional>
#include <string>

// Choosing and preparing the folder the catalogue lives in. Nothing here needs a display.
namespace app {

struct CommandLine;

// Looks up an environment variable; nothing when it is unset.
using Environment = std::function<std::optional<std::string>(const char* name)>;
Environment processEnvironment();

// Whether windows can be shown at all: a display, or a Qt platform named by the user.
bool displayAvailable(const Environment& env);

// The data folder as an absolute path: `option` (--data), else $PEMLA_DATA, else
// $XDG_DATA_HOME/pemla, else $HOME/.local/share/pemla; empty variables count as unset and a
// relative $XDG_DATA_HOME is ignored. Throws catalogue::CatalogueError when no folder can be
// named (an empty --data, no home folder).
std::string chooseDataFolder(const std::optional<std::string>& option, const Environment& env);

// Creates `folder` when it is missing and puts in it what it lacks of the supplied suggestion
// files (copied byte for byte from `supplied`) and an empty list index. A file that is there,
// even a link, is never replaced. Throws catalogue::CatalogueError naming the file and reason.
void prepareDataFolder(const std::string& folder, const std::string& supplied);

// The folder holding the running program's supplied files, found from the program file itself
// (links resolved), so an install works from any prefix and through a link.
std::string suppliedFolder();

// Chooses, prepares and enters the data folder, and returns it. Throws catalogue::CatalogueError
// whose reason is the whole message for the user, naming the folder and why it cannot be used.
std::string openDataFolder(const CommandLine& commandLine, const Environment& env);

// The one-line message for a data folder that cannot be used.
std::string dataFolderFailure(const std::string& folder, const std::string& file,
                              const std::string& reason);

}  // namespace app
