#include "app/command_tasks.h"

#include <fcntl.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>
#include <filesystem>
#include <memory>
#include <ostream>

#include "catalogue/catalogue_error.h"
#include "catalogue/csv.h"
#include "catalogue/entry_rules.h"
#include "catalogue/file_names.h"
#include "catalogue/file_text.h"
#include "catalogue/folder_lock.h"
#include "catalogue/latin1.h"
#include "catalogue/list_import.h"
#include "catalogue/store.h"
#include "export/export_settings.h"
#include "export/list_report.h"
#include "ui/qt/qt_platform.h"

namespace app {

namespace {

using catalogue::latin1ToUtf8;

// What a command could not do, for one line on standard error: list names and values converted
// to UTF-8, paths as the bytes they are.
struct Failure {
    std::string message;
};

// A catalogue file's failure; the file's name is already the file system's (UTF-8) bytes.
std::string fileError(const catalogue::CatalogueError& e) {
    return "The file \"" + e.file() + "\" could not be used: " + e.reason() + ".";
}

// The catalogue as the window's start-up leaves it: the folder locked like a window's, an
// interrupted save finished, and the files of lists saved by earlier builds under today's names
// (when that fails, the list in question fails later with its file named). Where a running copy
// holds the folder, finishing its journal or writing beside it could undo its work: a command
// that writes is refused, one that only reads takes the files as they are. The lock is held until
// the returned object goes.
std::unique_ptr<catalogue::FolderLock> openCatalogue(catalogue::Store& store, std::ostream& err,
                                                     bool writes) {
    auto lock = std::make_unique<catalogue::FolderLock>(store.folder());
    if (lock->state() == catalogue::FolderLock::State::Taken) {
        if (!writes) return lock;
        throw Failure{"Pemla is already running on the data folder \"" + store.folder() +
                      "\": close it first. Nothing was imported."};
    }
    store.recover();
    try {
        catalogue::renameLegacyListFiles(store, store.readLines(catalogue::kIndexFile));
    } catch (const catalogue::CatalogueError& e) {
        err << "pemla: " << fileError(e) << '\n';
    }
    return lock;
}

// The list name typed on the command line, as the catalogue's ISO-8859-1 bytes.
std::string listName(const std::string& typed) {
    if (!catalogue::isUtf8(typed)) {
        throw Failure{"The list name \"" + typed + "\" is not UTF-8 text."};
    }
    char32_t outside = 0;
    std::optional<std::string> name = catalogue::utf8ToLatin1(typed, &outside);
    if (!name) {
        char code[16];
        std::snprintf(code, sizeof code, "U+%04X", static_cast<unsigned>(outside));
        throw Failure{"The list name holds the character " + std::string(code) +
                      ", which no list name can hold (list names are Latin-1)."};
    }
    return *name;
}

// The index's spelling of a listed name (ignoring case).
std::string listedName(catalogue::Store& store, const std::string& name) {
    for (const std::string& line : store.readLines(catalogue::kIndexFile)) {
        if (catalogue::equalsIgnoreCase(line, name)) return line;
    }
    throw Failure{"There is no list \"" + latin1ToUtf8(name) + "\" in the data folder \"" +
                  store.folder() + "\"."};
}

// The report's choices: the export dialog's saved ones, or its defaults when none are saved.
exporting::ReportChoices savedChoices(catalogue::Store& store) {
    exporting::ExportSettings settings;
    try {
        if (store.exists(exporting::kSettingsFile)) {
            settings = exporting::decodeSettings(store.readBytes(exporting::kSettingsFile));
        }
    } catch (const catalogue::CatalogueError&) {
        // Unreadable settings: the dialog falls back to its defaults too.
    }
    exporting::ReportChoices choices;
    choices.counter = settings.checks[2] == 1;
    choices.date = settings.checks[3] == 1;
    choices.separatorLines = settings.checks[4] == 1;
    choices.lastAdded = settings.checks[5] == 1;
    choices.amountText = settings.amount;
    choices.position = settings.position;
    return choices;
}

std::string exportBytes(const CommandLine& line, catalogue::Store& store, const std::string& list,
                        std::ostream& err) {
    if (line.csv) return exporting::listCsv(store, list);
    exporting::ReportChoices choices = savedChoices(store);
    choices.articleNumbers = line.articleNumbers;
    choices.html = line.html;
    const std::string date = choices.date ? ui::qt::QtPlatform().shortDate() : std::string();
    exporting::ListReport report =
        exporting::buildListReport(store, list, exporting::listTitles(store, list), choices, date);
    if (report.lastAddedRefused) {
        err << "pemla: the export settings ask for more last added titles than the list holds; "
               "the report leaves that section out.\n";
    }
    return std::move(report.text);
}

std::string readWholeFile(const std::string& path) {
    std::string bytes;
    const int fd = ::open(path.c_str(), O_RDONLY | O_CLOEXEC);
    if (fd >= 0) {
        char buffer[65536];
        ssize_t got = 0;
        while ((got = ::read(fd, buffer, sizeof buffer)) > 0) {
            bytes.append(buffer, static_cast<std::size_t>(got));
        }
        const int error = errno;
        ::close(fd);
        if (got == 0) return bytes;
        errno = error;
    }
    throw Failure{"The file \"" + path + "\" could not be read: " + std::strerror(errno) + "."};
}

// A report written over one of the catalogue's own files would destroy it.
void refuseCatalogueFile(const std::string& output, const std::string& folder) {
    namespace fs = std::filesystem;
    std::error_code ec;
    const fs::path target = fs::weakly_canonical(output, ec);
    if (ec || target.parent_path() != fs::weakly_canonical(folder, ec) || ec) return;
    const std::string extension = target.extension().string();
    for (const char* kept : {".dat", ".art", ".arn", ".inf", ".journal"}) {
        if (extension == kept) {
            throw Failure{"The file \"" + output +
                          "\" is one of the catalogue's own files; choose another name."};
        }
    }
}

}  // namespace

void resolveCommandFiles(CommandLine& line) {
    std::error_code ec;
    if (!line.file.empty()) line.file = std::filesystem::absolute(line.file, ec).string();
    if (line.outputFile)
        *line.outputFile = std::filesystem::absolute(*line.outputFile, ec).string();
}

int exportCommand(const CommandLine& line, const std::string& folder, std::ostream& out,
                  std::ostream& err) {
    try {
        catalogue::Store store(folder);
        const auto lock = openCatalogue(store, err, false);
        const std::string list = listedName(store, listName(line.list));
        const std::string bytes = exportBytes(line, store, list, err);
        if (line.outputFile) {
            refuseCatalogueFile(*line.outputFile, folder);
            try {
                catalogue::writeFileAtomically(*line.outputFile, bytes, store.sys());
            } catch (const catalogue::CatalogueError& e) {
                throw Failure{"The file \"" + *line.outputFile +
                              "\" could not be written: " + e.reason() + "."};
            }
        } else if (!out.write(bytes.data(), static_cast<std::streamsize>(bytes.size())).flush()) {
            throw Failure{"Standard output could not be written."};
        }
        return 0;
    } catch (const Failure& f) {
        err << "pemla: " << f.message << '\n';
    } catch (const catalogue::CatalogueError& e) {
        err << "pemla: " << fileError(e) << '\n';
    }
    return 1;
}

int importCommand(const CommandLine& line, const std::string& folder, std::ostream& out,
                  std::ostream& err) {
    try {
        const std::string name = listName(line.list);
        const std::string csv = readWholeFile(line.file);
        catalogue::Store store(folder);
        const auto lock = openCatalogue(store, err, true);
        const catalogue::ImportResult result = catalogue::importCsv(store, name, csv);
        if (!result.problem.empty()) throw Failure{latin1ToUtf8(result.problem)};
        for (const auto& refused : result.refused) {
            err << "pemla: " << line.file << " line " << refused.line << ": "
                << latin1ToUtf8(refused.reason) << '\n';
        }
        out << result.added << (result.added == 1 ? " row" : " rows") << " added to the list \""
            << latin1ToUtf8(result.list) << "\"" << (result.created ? " (a new list)" : "") << ", "
            << result.refused.size() << " refused.\n";
        if (result.refused.empty()) return 0;
        return result.added > 0 ? 3 : 1;
    } catch (const Failure& f) {
        err << "pemla: " << f.message << '\n';
    } catch (const catalogue::CatalogueError& e) {
        err << "pemla: " << fileError(e) << " Nothing was imported.\n";
    }
    return 1;
}

}  // namespace app
