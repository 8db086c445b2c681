#pragma once

#include <optional>
#include <string>
#include <vector>

// What the user asked for on the command line, parsed without any display so that --help and
// --version work anywhere.
namespace app {

struct CommandLine {
    enum class Action { Run, Help, Version, Error, Export, Import };

    Action action = Action::Run;
    // The folder given with --data, as the bytes the user typed.
    std::optional<std::string> dataFolder;
    // Arguments that are not options, as the bytes the user typed; the command and its
    // arguments among them.
    std::vector<std::string> positional;
    // export LIST [--html] [--article-numbers] [--csv] [--output FILE], import LIST FILE: the
    // list and the file as the bytes the user typed, and export's options.
    std::string list;
    std::string file;
    std::optional<std::string> outputFile;
    bool html = false;
    bool articleNumbers = false;
    bool csv = false;
    // For Help and Version the text for standard output; for Error the reason and the usage for
    // standard error. Each ends with a newline.
    std::string output;
};

// Parses argv. Never exits and prints nothing: the caller prints `output` and chooses the exit
// status (0 for Help and Version, 2 for Error).
CommandLine parseCommandLine(int argc, const char* const* argv);

}  // namespace app
