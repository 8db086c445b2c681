// A transaction: the reads an operation is computed from, its planned changes, and their commit.
#include <sys/stat.h>

#include <algorithm>
#include <cerrno>
#include <set>

#include "catalogue/catalogue_error.h"
#include "catalogue/file_io.h"
#include "catalogue/file_text.h"
#include "catalogue/journal.h"
#include "catalogue/store.h"

namespace catalogue {

using namespace file_io;

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

void Transaction::write(const std::string& name, std::string&& text) {
    actions_.push_back({name, Kind::Write, forWriting(std::move(text))});
}

void Transaction::remove(const std::string& name) {
    actions_.push_back({name, Kind::Remove, {}});
}

void Transaction::rename(const std::string& from, const std::string& to) {
    store_.path(from);  // refuses a name outside the folder now rather than at the commit
    actions_.push_back({to, Kind::Rename, from});
}

FileStamp Transaction::written(const std::string& name) const {
    for (const auto& [file, stamp] : written_) {
        if (file == name) return stamp;
    }
    return {};
}

std::string Transaction::takeWritten(const std::string& name) {
    for (Action& action : committed_) {
        if (action.name == name && action.kind == Kind::Write) return std::move(action.bytes);
    }
    return {};
}

void Transaction::commit() {
    if (actions_.empty()) return;
    // The last plan for a name decides; earlier ones for it are dropped.
    std::vector<Action>& plan = committed_;
    plan.clear();
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
                FileStamp stamp;
                s.writeDurable(s.path(staged.back()), action.name, action.bytes,
                               mode ? &*mode : nullptr, &stamp);
                written_.emplace_back(action.name, stamp);
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

}  // namespace catalogue
