#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "catalogue/sys.h"

// Reading and writing the catalogue's files in one folder. Reads return file texts (every line
// followed by CR LF). Writes never touch a file in place: a Transaction stages every new content
// in a temporary file beside its target, records the plan in a journal, and then renames and
// deletes, so that after a failure or a crash at any point the files of one operation are either
// all old or all new. Every failure throws CatalogueError naming the file and the OS reason.
namespace catalogue {

inline constexpr std::string_view kJournalName = "pemla.journal";
inline constexpr std::string_view kTempSuffix = ".pemla-tmp";

class Store;

// One operation's set of changes. Nothing reaches the disk before commit().
class Transaction {
  public:
    explicit Transaction(Store& store) : store_(store) {}

    // Plans `name` to hold `text`, ending with exactly one CR LF after its last line.
    void write(const std::string& name, std::string_view text);
    // Plans `name` to be deleted; a file that does not exist is no error.
    void remove(const std::string& name);
    // Plans the file `from` to be renamed to `to`, its bytes untouched.
    void rename(const std::string& from, const std::string& to);
    // Carries out every planned change, all or nothing. A later plan for the same name replaces
    // an earlier one.
    void commit();

  private:
    enum class Kind { Write, Remove, Rename };
    struct Action {
        std::string name;
        Kind kind;
        std::string bytes;  // the new content, or the file renamed to `name`
    };
    Store& store_;
    std::vector<Action> actions_;
};

class Store {
  public:
    explicit Store(std::string folder, Sys& sys = realSys());

    const std::string& folder() const { return folder_; }
    Sys& sys() { return sys_; }

    // Full path of a file of the folder. Names are the file system's bytes (see file_names.h).
    // Throws CatalogueError for a name that is no plain file name: empty, "." or "..", or holding
    // "/" or a NUL byte.
    std::string path(std::string_view name) const;

    // The file's raw bytes. Throws when it cannot be opened or read.
    std::string readBytes(const std::string& name);
    // The file's text: every line followed by CR LF.
    std::string readText(const std::string& name);
    // The file's text, or nothing when the file does not exist (other failures throw).
    std::optional<std::string> readTextIfExists(const std::string& name);
    // The file's lines.
    std::vector<std::string> readLines(const std::string& name);
    // The first number of the file, or nothing when it does not start with one.
    std::optional<long> readNumber(const std::string& name);
    bool exists(const std::string& name) const;

    // Finishes or discards what an interrupted commit left: a complete journal is carried out
    // again, an incomplete one is dropped with its temporary files. Safe to run any time.
    void recover();

    Transaction begin() { return Transaction(*this); }

  private:
    friend class Transaction;

    void writeDurable(const std::string& fullPath, const std::string& shownName,
                      std::string_view bytes);
    void syncFolder();
    std::string tempName(const std::string& name);
    void apply(const std::vector<std::pair<std::string, std::string>>& renames,
               const std::vector<std::string>& deletions);

    std::string folder_;
    Sys& sys_;
    unsigned long serial_ = 0;
};

// Writes one file atomically, outside any catalogue folder (reports): a temporary file in the
// same folder, flushed, then renamed over the target. Throws CatalogueError on any failure,
// leaving an older file of that name untouched.
void writeFileAtomically(const std::string& fullPath, std::string_view bytes, Sys& sys = realSys());

}  // namespace catalogue
