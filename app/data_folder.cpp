#include "app/data_folder.h"

#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstdlib>
#include <filesystem>
#include <system_error>
#include <utility>
#include <vector>

#include "app/command_line.h"
#include "catalogue/catalogue_error.h"
#include "catalogue/store.h"

namespace app {

namespace {

std::optional<std::string> nonEmpty(const Environment& env, const char* name) {
    std::optional<std::string> value = env(name);
    if (value && value->empty()) return std::nullopt;
    return value;
}

std::string absolute(const std::string& path) {
    if (path.starts_with('/')) return path;
    std::error_code ec;
    const std::filesystem::path here = std::filesystem::current_path(ec);
    if (ec) throw catalogue::CatalogueError(path, ec.message());
    return (here / path).string();
}

}  // namespace

Environment processEnvironment() {
    return [](const char* name) -> std::optional<std::string> {
        const char* value = std::getenv(name);
        if (value == nullptr) return std::nullopt;
        return std::string(value);
    };
}

bool displayAvailable(const Environment& env) {
    return nonEmpty(env, "DISPLAY") || nonEmpty(env, "WAYLAND_DISPLAY") ||
           nonEmpty(env, "QT_QPA_PLATFORM");
}

std::string chooseDataFolder(const std::optional<std::string>& option, const Environment& env) {
    if (option) {
        if (option->empty()) throw catalogue::CatalogueError("--data", "no folder given");
        return absolute(*option);
    }
    if (auto folder = nonEmpty(env, "PEMLA_DATA")) return absolute(*folder);
    if (auto xdg = nonEmpty(env, "XDG_DATA_HOME"); xdg && xdg->starts_with('/')) {
        return *xdg + "/pemla";
    }
    if (auto home = nonEmpty(env, "HOME")) return absolute(*home) + "/.local/share/pemla";
    throw catalogue::CatalogueError("$HOME", "no home folder is set; name a folder with --data");
}

void prepareDataFolder(const std::string& folder, const std::string& supplied) {
    std::error_code ec;
    std::filesystem::create_directories(folder, ec);
    if (ec) throw catalogue::CatalogueError(folder, ec.message());
    if (!std::filesystem::is_directory(folder, ec)) {
        throw catalogue::osError(folder, ENOTDIR);
    }

    // Everything missing is read first, so a damaged install leaves the folder as it was.
    catalogue::Store data(folder);
    catalogue::Store origin(supplied);
    std::vector<std::pair<std::string, std::string>> missing;
    for (const char* name : {"type.dat", "information.dat", "pemla.dat"}) {
        struct stat st {};
        if (::lstat(data.path(name).c_str(), &st) == 0) continue;
        if (errno != ENOENT) throw catalogue::osError(name, errno);
        std::string bytes;
        if (std::string_view(name) != "pemla.dat") {
            try {
                bytes = origin.readBytes(name);
            } catch (const catalogue::CatalogueError& e) {
                throw catalogue::CatalogueError(origin.path(name), e.reason());
            }
        }
        missing.emplace_back(name, std::move(bytes));
    }
    for (const auto& [name, bytes] : missing) {
        catalogue::writeFileAtomically(data.path(name), bytes);
    }
}

std::string suppliedFolder() {
    std::error_code ec;
    const std::filesystem::path program = std::filesystem::read_symlink("/proc/self/exe", ec);
    if (ec) throw catalogue::CatalogueError("/proc/self/exe", ec.message());
    return (program.parent_path() / PEMLA_SUPPLIED_RELATIVE).lexically_normal().string();
}

std::string openDataFolder(const CommandLine& commandLine, const Environment& env) {
    std::string folder = commandLine.dataFolder.value_or("");
    try {
        folder = chooseDataFolder(commandLine.dataFolder, env);
        prepareDataFolder(folder, suppliedFolder());
        // Settings saved by older builds may name report folders relative to the data folder.
        if (::chdir(folder.c_str()) != 0) throw catalogue::osError(folder, errno);
    } catch (const catalogue::CatalogueError& e) {
        throw catalogue::CatalogueError(folder, dataFolderFailure(folder, e.file(), e.reason()));
    }
    return folder;
}

std::string dataFolderFailure(const std::string& folder, const std::string& file,
                              const std::string& reason) {
    std::string message = folder.empty() ? std::string("No data folder can be chosen: ")
                                         : "The data folder \"" + folder + "\" cannot be used: ";
    if (!file.empty() && file != folder) message += file + ": ";
    return message + reason + ".";
}

}  // namespace app
