#include "catalogue/store.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <filesystem>
#include <set>

#include "catalogue/catalogue_error.h"
#include "catalogue/file_io.h"
#include "catalogue/file_text.h"
#include "catalogue/journal.h"

namespace catalogue {

namespace {

using namespace file_io;

// A complete journal that cannot be carried out blocks every later write: it says so, naming
// the journal and what failed.
CatalogueError stuckJournal(const CatalogueError& cause) {
    return CatalogueError(std::string(kJournalName),
                          "an earlier change recorded in it could not be finished (" +
                              cause.file() + ": " + cause.reason() +
                              "), so nothing else is written until it is");
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
