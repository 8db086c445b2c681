#pragma once

#include <sys/stat.h>

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "catalogue/catalogue_error.h"
#include "catalogue/journal.h"
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

// Which file a name stood for when it was read: enough to tell whether it has been replaced or
// rewritten since (a new file has a new inode; a rewrite moves the modification time). A change
// of owner or permissions alone is no change. A name that was missing has a stamp too.
struct FileStamp {
    bool exists = false;
    dev_t device = 0;
    ino_t inode = 0;
    off_t size = 0;
    timespec modified{};

    bool operator==(const FileStamp& other) const;
};

// A file that an operation was computed from was replaced or rewritten on disk before its
// commit; nothing was written.
class ChangedOnDisk : public CatalogueError {
  public:
    using CatalogueError::CatalogueError;
};

// A commit failed after its point of no return and its retry failed too: the change is recorded
// in the journal and is finished before anything else is written. The files may show part of it.
class UnfinishedChange : public CatalogueError {
  public:
    using CatalogueError::CatalogueError;
};

// One operation's set of changes. Nothing reaches the disk before commit().
class Transaction {
  public:
    explicit Transaction(Store& store) : store_(store) {}

    // The operation's reads: the file's text (or nothing when it is missing), remembered as
    // read, so that commit() refuses should the file change on disk in the meantime.
    std::string readText(const std::string& name);
    std::optional<std::string> readTextIfExists(const std::string& name);
    // Records that the operation is computed from `name` as it was when `stamp` was taken.
    void expect(const std::string& name, const FileStamp& stamp);

    // Plans `name` to hold `text`, ending with exactly one CR LF after its last line. The second
    // form takes the text over instead of copying it; takeWritten() hands it back.
    void write(const std::string& name, std::string_view text);
    void write(const std::string& name, std::string&& text);
    void write(const std::string& name, const char* text) { write(name, std::string_view(text)); }
    // Plans `name` to be deleted; a file that does not exist is no error.
    void remove(const std::string& name);
    // Plans the file `from` to be renamed to `to`, its bytes untouched.
    void rename(const std::string& from, const std::string& to);
    // Carries out every planned change, all or nothing. A later plan for the same name replaces
    // an earlier one. Finishes a pending journal first (throws naming it when it cannot), then
    // throws ChangedOnDisk when an expected file is no longer the one that was read. A failure
    // after the point of no return that a retry cannot mend throws UnfinishedChange. A replaced
    // file keeps its permission bits.
    void commit();
    // After commit(): the stamp of a file it wrote, as the file stands in place; a file it did
    // not write has no stamp (exists is false).
    FileStamp written(const std::string& name) const;
    // After commit(): the bytes it wrote to `name`, moved out of the transaction; empty for a
    // file it did not write.
    std::string takeWritten(const std::string& name);

  private:
    enum class Kind { Write, Remove, Rename };
    struct Action {
        std::string name;
        Kind kind;
        std::string bytes;  // the new content, or the file renamed to `name`
    };
    Store& store_;
    std::vector<Action> actions_;
    std::vector<Action> committed_;
    std::vector<std::pair<std::string, FileStamp>> expected_;
    std::vector<std::pair<std::string, FileStamp>> written_;
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

    // The file's raw bytes, and its stamp when asked. Only a regular file is read; a FIFO, a
    // device or a folder is refused without waiting on it. Throws when it cannot be read.
    std::string readBytes(const std::string& name, FileStamp* stamp = nullptr);
    // The file's text: every line followed by CR LF.
    std::string readText(const std::string& name);
    // The file's text, or nothing when the file does not exist (other failures throw).
    std::optional<std::string> readTextIfExists(const std::string& name);
    // The file's lines.
    std::vector<std::string> readLines(const std::string& name);
    // The first number of the file, or nothing when it does not start with one.
    std::optional<long> readNumber(const std::string& name);
    bool exists(const std::string& name) const;
    // The name's stamp as it is now.
    FileStamp stampOf(const std::string& name) const;

    // Start-up: finishes or discards what an interrupted commit left (a complete journal is
    // carried out again, an incomplete one is dropped) and removes stray staged files. Throws
    // when a complete journal cannot be finished; it then stays for the next try.
    void recover();
    // Finishes or drops a pending journal, if there is one; true when that changed catalogue
    // files. Throws CatalogueError naming the journal when it cannot, so that nothing else is
    // written until it is.
    bool settle();
    // The same for an operation that only reads: files the journal cannot finish now are left
    // as they are.
    void trySettle();

    // A new operation, after any pending journal is settled (throws as settle() does).
    Transaction begin();

    // Records short-lived files (a name probe of the folder, a report's staged copy anywhere)
    // before they are created, so that a start after a kill removes them. One record at a
    // time; clearStrays() drops it once they are gone. Throws CatalogueError.
    void recordStrays(const std::vector<std::string>& paths);
    void clearStrays();

    // Writes a report outside the folder as writeFileAtomically() does, its staged copy recorded
    // as a stray meanwhile. Throws CatalogueError.
    void writeReport(const std::string& fullPath, std::string_view bytes);

  private:
    friend class Transaction;

    void writeDurable(const std::string& fullPath, const std::string& shownName,
                      std::string_view bytes, const mode_t* keepMode = nullptr,
                      FileStamp* written = nullptr);
    void syncFolder();
    std::string tempName(const std::string& name);
    void apply(const JournalPlan& plan);

    std::string folder_;
    Sys& sys_;
    unsigned long serial_ = 0;
};

// Writes one file atomically, outside any catalogue folder (reports): a temporary file in the
// same folder (stagedPathOf), flushed, then renamed over the target, whose permission bits it
// keeps. Throws CatalogueError on any failure, leaving an older file of that name untouched.
std::string stagedPathOf(const std::string& fullPath);
void writeFileAtomically(const std::string& fullPath, std::string_view bytes, Sys& sys = realSys());

}  // namespace catalogue
