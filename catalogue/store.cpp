#include "catalogue/store.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <filesystem>
#include <set>

#include "catalogue/catalogue_error.h"
#include "catalogue/file_text.h"
#include "catalogue/journal.h"

namespace catalogue {

namespace {

const std::string kJournalTemp = std::string(kJournalName) + std::string(kTempSuffix);

FileStamp stampFrom(const struct stat& st) {
    FileStamp stamp;
    stamp.exists = true;
    stamp.device = st.st_dev;
    stamp.inode = st.st_ino;
    stamp.size = st.st_size;
    stamp.modified = st.st_mtim;
    return stamp;
}

// Reads a whole regular file through `sys`; errors name `shown`. The descriptor is opened without
// blocking and checked before the first read, so a FIFO or a device never stalls the program.
std::string readAll(Sys& sys, const std::string& fullPath, const std::string& shown,
                    FileStamp* stamp = nullptr) {
    const int fd = sys.open(fullPath, O_RDONLY | O_NONBLOCK, 0);
    if (fd < 0) throw osError(shown, errno);
    struct stat st {};
    if (::fstat(fd, &st) != 0) {
        const int err = errno;
        sys.close(fd);
        throw osError(shown, err);
    }
    if (!S_ISREG(st.st_mode)) {
        sys.close(fd);
        if (S_ISDIR(st.st_mode)) throw osError(shown, EISDIR);
        throw CatalogueError(shown, "it is a FIFO or a device, not a file");
    }
    if (stamp != nullptr) *stamp = stampFrom(st);
    std::string bytes;
    bytes.reserve(static_cast<size_t>(st.st_size));
    char buffer[65536];
    for (;;) {
        const ssize_t got = sys.read(fd, buffer, sizeof buffer);
        if (got < 0) {
            if (errno == EINTR) continue;
            const int err = errno;
            sys.close(fd);
            throw osError(shown, err);
        }
        if (got == 0) break;
        bytes.append(buffer, static_cast<size_t>(got));
    }
    sys.close(fd);
    return bytes;
}

std::string baseName(const std::string& path) {
    const std::size_t slash = path.rfind('/');
    return slash == std::string::npos ? path : path.substr(slash + 1);
}

std::string folderOf(const std::string& path) {
    const std::size_t slash = path.rfind('/');
    if (slash == std::string::npos) return ".";
    if (slash == 0) return "/";
    return path.substr(0, slash);
}

// Writes a staged file. `keepMode` gives it the permission bits of the file it will replace; a
// file system that keeps no such bits may refuse them, which is no error. Without `durable` the
// data is not flushed: for records that only a killed process needs.
void writeAll(Sys& sys, const std::string& fullPath, const std::string& shown,
              std::string_view bytes, const mode_t* keepMode = nullptr, bool durable = true) {
    const int fd = sys.open(fullPath, O_WRONLY | O_CREAT | O_TRUNC | O_NONBLOCK, 0666);
    if (fd < 0) throw osError(shown, errno);
    if (keepMode != nullptr) (void)::fchmod(fd, *keepMode);
    std::size_t done = 0;
    while (done < bytes.size()) {
        const ssize_t wrote = sys.write(fd, bytes.data() + done, bytes.size() - done);
        if (wrote < 0) {
            if (errno == EINTR) continue;
            const int err = errno;
            sys.close(fd);
            sys.unlink(fullPath);
            throw osError(shown, err);
        }
        done += static_cast<std::size_t>(wrote);
    }
    if (durable && sys.fsync(fd) != 0) {
        const int err = errno;
        sys.close(fd);
        sys.unlink(fullPath);
        throw osError(shown, err);
    }
    if (sys.close(fd) != 0) {
        const int err = errno;
        sys.unlink(fullPath);
        throw osError(shown, err);
    }
}

void syncDirectory(Sys& sys, const std::string& folder, const std::string& shown) {
    const int fd = sys.open(folder, O_RDONLY | O_DIRECTORY, 0);
    if (fd < 0) throw osError(shown, errno);
    if (sys.fsync(fd) != 0) {
        const int err = errno;
        sys.close(fd);
        throw osError(shown, err);
    }
    sys.close(fd);
}

// The permission bits of a regular file about to be replaced, to give its successor.
std::optional<mode_t> modeOf(const std::string& fullPath) {
    struct stat st {};
    if (::stat(fullPath.c_str(), &st) != 0 || !S_ISREG(st.st_mode)) return std::nullopt;
    return st.st_mode & 07777;
}

// A complete journal that cannot be carried out blocks every later write: it says so, naming
// the journal and what failed.
CatalogueError stuckJournal(const CatalogueError& cause) {
    return CatalogueError(std::string(kJournalName),
                          "an earlier change recorded in it could not be finished (" +
                              cause.file() + ": " + cause.reason() +
                              "), so nothing else is written until it is");
}

// A file with every write permission bit cleared is one the user protected: it is neither
// replaced nor deleted, even where the process could (as root, or by renaming over it).
void refuseProtected(const std::string& fullPath, const std::string& shown) {
    struct stat st {};
    if (::stat(fullPath.c_str(), &st) == 0 && S_ISREG(st.st_mode) && (st.st_mode & 0222) == 0) {
        throw osError(shown, EACCES);
    }
}

// A target that the rename or unlink after the commit point would fail on (a folder, a name the
// system refuses) could never be finished by any recovery: it is refused while nothing changed.
void refuseUnreplaceable(const std::string& fullPath, const std::string& shown, bool replacing) {
    struct stat st {};
    if (::lstat(fullPath.c_str(), &st) != 0) {
        if (errno != ENOENT) throw osError(shown, errno);
        return;
    }
    if (S_ISDIR(st.st_mode)) throw osError(shown, EISDIR);
    // Nor is a FIFO or a device that the user put in a file's place replaced by a file.
    if (replacing && !S_ISREG(st.st_mode) && !S_ISLNK(st.st_mode)) {
        throw CatalogueError(shown, "it is a FIFO or a device, not a file");
    }
}

}  // namespace

bool FileStamp::operator==(const FileStamp& other) const {
    if (exists != other.exists) return false;
    return !exists ||
           (device == other.device && inode == other.inode && size == other.size &&
            modified.tv_sec == other.modified.tv_sec && modified.tv_nsec == other.modified.tv_nsec);
}

Store::Store(std::string folder, Sys& sys) : folder_(std::move(folder)), sys_(sys) {
    if (folder_.empty()) folder_ = ".";
}

std::string Store::path(std::string_view name) const {
    // Names come from the list index too, which may have been edited by hand: one holding a NUL
    // byte would be cut short by the system and one holding "/" would reach another folder.
    if (name.empty() || name == "." || name == ".." ||
        name.find_first_of(std::string_view("/\0", 2)) != std::string_view::npos) {
        throw CatalogueError(std::string(name), "this is no file name of the catalogue folder");
    }
    std::string full = folder_;
    if (!full.ends_with('/')) full.push_back('/');
    full.append(name);
    return full;
}

std::string Store::readBytes(const std::string& name, FileStamp* stamp) {
    return readAll(sys_, path(name), name, stamp);
}

std::string Store::readText(const std::string& name) {
    return toFileText(readBytes(name));
}

std::optional<std::string> Store::readTextIfExists(const std::string& name) {
    struct stat st {};
    if (::lstat(path(name).c_str(), &st) != 0 && errno == ENOENT) return std::nullopt;
    return readText(name);
}

std::vector<std::string> Store::readLines(const std::string& name) {
    const std::string bytes = readBytes(name);
    std::vector<std::string> lines;
    for (std::string_view line : splitLines(bytes)) lines.emplace_back(line);
    return lines;
}

std::optional<long> Store::readNumber(const std::string& name) {
    return firstNumber(readBytes(name));
}

bool Store::exists(const std::string& name) const {
    struct stat st {};
    return ::stat(path(name).c_str(), &st) == 0;
}

FileStamp Store::stampOf(const std::string& name) const {
    struct stat st {};
    if (::stat(path(name).c_str(), &st) == 0) return stampFrom(st);
    if (errno == ENOENT) return {};
    throw osError(name, errno);
}

void Store::writeDurable(const std::string& fullPath, const std::string& shownName,
                         std::string_view bytes, const mode_t* keepMode) {
    writeAll(sys_, fullPath, shownName, bytes, keepMode);
}

void Store::syncFolder() {
    syncDirectory(sys_, folder_, folder_);
}

std::string Store::tempName(const std::string& name) {
    return name + "." + std::to_string(::getpid()) + "-" + std::to_string(++serial_) +
           std::string(kTempSuffix);
}

void Store::apply(const JournalPlan& plan) {
    for (const auto& [staged, target] : plan.renames) {
        if (sys_.rename(path(staged), path(target)) != 0) {
            // A staged file that is gone was renamed by an earlier, interrupted attempt.
            if (errno == ENOENT && !exists(staged)) continue;
            throw osError(target, errno);
        }
    }
    for (const auto& target : plan.deletions) {
        if (sys_.unlink(path(target)) != 0 && errno != ENOENT) throw osError(target, errno);
    }
    // Strays hold nothing of the user's: one that cannot go now is no reason to keep the journal.
    for (const auto& stray : plan.strays) sys_.unlink(stray.starts_with('/') ? stray : path(stray));
    const bool changed = !plan.renames.empty() || !plan.deletions.empty();
    if (changed) syncFolder();
    const std::string journal(kJournalName);
    if (sys_.unlink(path(journal)) != 0 && errno != ENOENT) throw osError(journal, errno);
    if (changed) syncFolder();
}

bool Store::settle() {
    const std::string journal(kJournalName);
    struct stat st {};
    if (::lstat(path(journal).c_str(), &st) != 0 && errno == ENOENT) return false;
    try {
        // A journal that cannot be read now may still be complete: it stays, since dropping it
        // could leave a half-applied change for good.
        const std::optional<JournalPlan> plan =
            decodeJournal(readAll(sys_, path(journal), journal));
        if (plan) {
            apply(*plan);
            return !plan->renames.empty() || !plan->deletions.empty();
        }
        if (sys_.unlink(path(journal)) != 0 && errno != ENOENT) {
            throw osError(journal, errno);
        }
        return false;
    } catch (const CatalogueError& error) {
        throw stuckJournal(error);
    }
}

void Store::trySettle() {
    try {
        settle();
    } catch (const CatalogueError&) {
    }
}

void Store::recover() {
    settle();
    // Whatever staged files remain belong to commits that never reached their journal.
    std::error_code ec;
    for (const auto& item : std::filesystem::directory_iterator(folder_, ec)) {
        const std::string name = item.path().filename().string();
        if (name.ends_with(kTempSuffix)) sys_.unlink(path(name));
    }
}

Transaction Store::begin() {
    settle();
    return Transaction(*this);
}

void Store::recordStrays(const std::vector<std::string>& paths) {
    settle();
    JournalPlan plan;
    for (const std::string& stray : paths) {
        if (!isStrayPath(stray)) throw CatalogueError(stray, "this is no short-lived file");
        plan.strays.push_back(stray);
    }
    // No flush: the record only serves a process that is killed, whose written data the system
    // keeps; after a power cut at worst a stray file is left.
    const std::string journal(kJournalName);
    try {
        writeAll(sys_, path(kJournalTemp), journal, encodeJournal(plan), nullptr, false);
        if (sys_.rename(path(kJournalTemp), path(journal)) != 0) throw osError(journal, errno);
    } catch (const CatalogueError&) {
        sys_.unlink(path(kJournalTemp));
        throw;
    }
}

void Store::clearStrays() {
    // Tried twice; a record that stays is removed by the next operation or start.
    const std::string journal = path(kJournalName);
    if (sys_.unlink(journal) != 0 && errno != ENOENT) sys_.unlink(journal);
}

void Store::writeReport(const std::string& fullPath, std::string_view bytes) {
    std::error_code ec;
    std::filesystem::path absolute = std::filesystem::absolute(fullPath, ec);
    const std::string target = ec ? fullPath : absolute.lexically_normal().string();
    recordStrays({stagedPathOf(target)});
    try {
        writeFileAtomically(target, bytes, sys_);
    } catch (const CatalogueError&) {
        clearStrays();
        throw;
    }
    clearStrays();
}

std::string Transaction::readText(const std::string& name) {
    FileStamp stamp;
    std::string text = toFileText(store_.readBytes(name, &stamp));
    expected_.emplace_back(name, stamp);
    return text;
}

std::optional<std::string> Transaction::readTextIfExists(const std::string& name) {
    struct stat st {};
    if (::lstat(store_.path(name).c_str(), &st) != 0 && errno == ENOENT) {
        expected_.emplace_back(name, FileStamp{});
        return std::nullopt;
    }
    return readText(name);
}

void Transaction::expect(const std::string& name, const FileStamp& stamp) {
    expected_.emplace_back(name, stamp);
}

void Transaction::write(const std::string& name, std::string_view text) {
    actions_.push_back({name, Kind::Write, forWriting(text)});
}

void Transaction::remove(const std::string& name) {
    actions_.push_back({name, Kind::Remove, {}});
}

void Transaction::rename(const std::string& from, const std::string& to) {
    store_.path(from);  // refuses a name outside the folder now rather than at the commit
    actions_.push_back({to, Kind::Rename, from});
}

void Transaction::commit() {
    if (actions_.empty()) return;
    // The last plan for a name decides; earlier ones for it are dropped.
    std::vector<Action> plan;
    std::set<std::string> seen;
    for (auto it = actions_.rbegin(); it != actions_.rend(); ++it) {
        if (seen.insert(it->name).second) plan.push_back(std::move(*it));
    }
    actions_.clear();
    std::reverse(plan.begin(), plan.end());

    Store& s = store_;
    s.settle();
    // Checked as late as can be: what the operation was computed from must still be on disk.
    for (const auto& [name, stamp] : expected_) {
        if (!(s.stampOf(name) == stamp)) {
            throw ChangedOnDisk(name, "it was changed on disk after it was read");
        }
    }
    for (const Action& action : plan) {
        refuseProtected(s.path(action.name), action.name);
        refuseUnreplaceable(s.path(action.name), action.name, action.kind != Kind::Remove);
    }

    JournalPlan journal;
    std::vector<std::string> staged;  // only these may be removed when the commit is given up
    try {
        for (const Action& action : plan) {
            if (action.kind == Kind::Rename) {
                journal.renames.emplace_back(action.bytes, action.name);
            } else if (action.kind == Kind::Write) {
                staged.push_back(s.tempName(action.name));
                journal.renames.emplace_back(staged.back(), action.name);
                const std::optional<mode_t> mode = modeOf(s.path(action.name));
                s.writeDurable(s.path(staged.back()), action.name, action.bytes,
                               mode ? &*mode : nullptr);
            } else {
                journal.deletions.push_back(action.name);
            }
        }
    } catch (...) {
        for (const auto& name : staged) s.sys_.unlink(s.path(name));
        throw;
    }

    if (plan.size() == 1 && plan.front().kind != Kind::Rename) {
        // One file: a rename or an unlink is atomic by itself.
        if (plan.front().kind == Kind::Write) {
            const auto& [temp, target] = journal.renames.front();
            if (s.sys_.rename(s.path(temp), s.path(target)) != 0) {
                const int err = errno;
                s.sys_.unlink(s.path(temp));
                throw osError(target, err);
            }
        } else if (s.sys_.unlink(s.path(plan.front().name)) != 0 && errno != ENOENT) {
            throw osError(plan.front().name, errno);
        }
        // The change is made now and cannot be taken back, so a failed folder flush is retried
        // once rather than reported as a change that did not happen.
        try {
            s.syncFolder();
        } catch (const CatalogueError&) {
            s.syncFolder();
        }
        return;
    }

    auto discard = [&] {
        for (const auto& name : staged) s.sys_.unlink(s.path(name));
        s.sys_.unlink(s.path(kJournalTemp));
    };
    const std::string journalName(kJournalName);
    try {
        s.writeDurable(s.path(kJournalTemp), journalName, encodeJournal(journal));
        if (s.sys_.rename(s.path(kJournalTemp), s.path(journalName)) != 0) {
            throw osError(journalName, errno);
        }
    } catch (...) {
        discard();
        throw;
    }
    try {
        s.syncFolder();
    } catch (...) {
        // Not known to be durable: take the journal back. Should that fail too, the journal
        // is complete and the next recovery finishes the change, which is just as whole.
        if (s.sys_.unlink(s.path(journalName)) == 0) discard();
        throw;
    }
    // Committed. A failure from here on is retried once; should the retry fail as well, the
    // journal stays and every later operation finishes it before anything else.
    try {
        s.apply(journal);
    } catch (const CatalogueError&) {
        try {
            s.settle();
        } catch (const CatalogueError& again) {
            throw UnfinishedChange(again.file(), again.reason());
        }
    }
}

std::string stagedPathOf(const std::string& fullPath) {
    return fullPath + "." + std::to_string(::getpid()) + std::string(kTempSuffix);
}

void writeFileAtomically(const std::string& fullPath, std::string_view bytes, Sys& sys) {
    const std::string shown = baseName(fullPath);
    refuseProtected(fullPath, shown);
    const std::optional<mode_t> mode = modeOf(fullPath);
    // A staged copy of this file left by an earlier write that was stopped dead, and whose
    // record was lost with it (a power cut, an older build), goes first.
    std::error_code ec;
    for (const auto& item : std::filesystem::directory_iterator(folderOf(fullPath), ec)) {
        const std::string name = item.path().filename().string();
        if (name.starts_with(shown + ".") && name.ends_with(kTempSuffix)) {
            const std::string_view middle = std::string_view(name).substr(
                shown.size() + 1, name.size() - shown.size() - 1 - kTempSuffix.size());
            if (!middle.empty() &&
                middle.find_first_not_of("0123456789") == std::string_view::npos) {
                sys.unlink(item.path().string());
            }
        }
    }
    const std::string staged = stagedPathOf(fullPath);
    writeAll(sys, staged, shown, bytes, mode ? &*mode : nullptr);
    if (sys.rename(staged, fullPath) != 0) {
        const int err = errno;
        sys.unlink(staged);
        throw osError(shown, err);
    }
    // The report is in place; a failed folder flush is tried once more before it is reported.
    try {
        syncDirectory(sys, folderOf(fullPath), folderOf(fullPath));
    } catch (const CatalogueError&) {
        syncDirectory(sys, folderOf(fullPath), folderOf(fullPath));
    }
}

}  // namespace catalogue
