// Fault and crash sweeps over Transaction::commit: every system call of a commit is made to fail,
// or the commit is stopped dead before it, one point at a time, and the folder must then hold
// exactly the old set of files or exactly the new one.
#include <gtest/gtest.h>

#include <cerrno>
#include <cstring>
#include <filesystem>
#include <iostream>
#include <map>
#include <optional>

#include "catalogue/catalogue_error.h"
#include "catalogue/store.h"
#include "tests/support/faulty_sys.h"
#include "tests/support/temp_folder.h"

namespace catalogue {
namespace {

using test_support::CrashStop;
using test_support::FaultySys;
using test_support::SysCall;
using test_support::TempFolder;

// Every file of the folder by name, temporary files and the journal included.
using Files = std::map<std::string, std::string>;

const Files kOld = {
    {"pemla.dat", "Rock\r\n"},
    {"Rock.dat", "<|?Abba Gold\r\n<|'CD\r\n<||1\r\n<|*Pop\r\n"},
    {"Rock.art", "Abba Gold#*\\A001\r\n"},
    {"Rock.arn", "A#002\r\n"},
    {"Rock.inf", " 1 \r\n"},
};

struct Row {
    const char* name;
    std::vector<std::pair<std::string, std::optional<std::string>>> changes;  // nothing: delete
};

const Row kRows[] = {
    {"ThreeWritesAndADeletion",
     {{"Rock.dat",
       "<|?Abba Gold\r\n<|'CD\r\n<||1\r\n<|*Pop\r\n<|?Blur\r\n<|'LP\r\n<||2\r\n<|*\r\n"},
      {"Rock.art", "Abba Gold#*\\A001\r\nBlur#*\\B001\r\n"},
      {"Rock.arn", "A#002\r\nB#002\r\n"},
      {"Rock.inf", std::nullopt}}},
    {"OneWrite", {{"Rock.arn", "A#003\r\n"}}},
    {"OneDeletion", {{"Rock.inf", std::nullopt}}},
};

void PrintTo(const Row& row, std::ostream* out) {
    *out << row.name;
}

Files newFiles(const Row& row) {
    Files files = kOld;
    for (const auto& [name, content] : row.changes) {
        if (content) {
            files[name] = *content;
        } else {
            files.erase(name);
        }
    }
    return files;
}

void commit(Store& store, const Row& row) {
    Transaction t = store.begin();
    for (const auto& [name, content] : row.changes) {
        if (content) {
            t.write(name, *content);
        } else {
            t.remove(name);
        }
    }
    t.commit();
}

class CommitFaults : public ::testing::TestWithParam<Row> {
  protected:
    void reset() {
        for (const auto& item : std::filesystem::directory_iterator(folder.path())) {
            std::filesystem::remove(item.path());
        }
        for (const auto& [name, bytes] : kOld) folder.put(name, bytes);
    }
    Files state() const {
        Files files;
        for (const auto& item : std::filesystem::directory_iterator(folder.path())) {
            const std::string name = item.path().filename().string();
            files[name] = folder.get(name);
        }
        return files;
    }
    // Prints the fault points covered, per kind, to the log and the test report.
    int report(const std::string& what, const std::map<std::string, int>& points) {
        int total = 0;
        std::string line;
        for (const auto& [kind, n] : points) {
            total += n;
            line += " " + kind + "=" + std::to_string(n);
        }
        std::cout << GetParam().name << ": " << total << " " << what << " covered:" << line << "\n";
        RecordProperty(what, total);
        return total;
    }

    TempFolder folder;
};

TEST_P(CommitFaults, AFailingCallLeavesTheOldOrTheNewSet) {
    const Row& row = GetParam();
    const Files newSet = newFiles(row);
    std::map<std::string, int> points;
    for (SysCall kind : test_support::kAllSysCalls) {
        const int errnum = kind == SysCall::Write ? ENOSPC : EIO;
        for (int n = 1;; ++n) {
            SCOPED_TRACE(std::string(sysCallName(kind)) + " #" + std::to_string(n));
            reset();
            FaultySys sys;
            sys.capWrites(16);  // several writes per file, so a write can fail half-way
            sys.failAt(kind, n, errnum);
            Store store(folder.path(), sys);
            bool threw = false;
            try {
                commit(store, row);
            } catch (const CatalogueError& e) {
                threw = true;
                EXPECT_EQ(e.reason(), std::strerror(errnum));
                EXPECT_FALSE(e.file().empty());
            }
            if (!sys.fired()) {
                EXPECT_FALSE(threw);
                EXPECT_EQ(state(), newSet);
                break;
            }
            ++points[sysCallName(kind)];
            // Whole either way, and no staged file or journal left behind even before recovery.
            EXPECT_EQ(state(), threw ? kOld : newSet) << (threw ? "threw" : "returned");
            Store(folder.path()).recover();
            EXPECT_EQ(state(), threw ? kOld : newSet) << (threw ? "threw" : "returned");
            commit(store, row);  // the same change again, on the same store
            EXPECT_EQ(state(), newSet);
        }
    }
    // At least the staging or removal and the folder flush of every file were hit.
    EXPECT_GE(report("fault points", points), static_cast<int>(4 * row.changes.size()));
}

TEST_P(CommitFaults, ACrashAtAnyStepRecoversToTheOldOrTheNewSet) {
    const Row& row = GetParam();
    const Files newSet = newFiles(row);
    std::map<std::string, int> outcomes;
    for (int step = 1;; ++step) {
        SCOPED_TRACE("crash at step " + std::to_string(step));
        reset();
        FaultySys sys;
        sys.capWrites(16);
        sys.crashAt(step);
        {
            Store store(folder.path(), sys);
            EXPECT_NO_THROW({
                try {
                    commit(store, row);
                } catch (const CrashStop&) {
                }
            });
        }
        if (!sys.fired()) {
            EXPECT_EQ(state(), newSet);
            break;
        }
        Store real(folder.path());
        real.recover();
        const Files after = state();
        if (after == kOld) {
            ++outcomes["all old"];
        } else if (after == newSet) {
            ++outcomes["all new"];
        } else {
            ADD_FAILURE() << "mixed set after recovery";
        }
        commit(real, row);
        EXPECT_EQ(state(), newSet);
    }
    report("crash points", outcomes);
    EXPECT_GT(outcomes["all old"], 0);
    EXPECT_GT(outcomes["all new"], 0);
}

INSTANTIATE_TEST_SUITE_P(Store, CommitFaults, ::testing::ValuesIn(kRows),
                         [](const auto& info) { return std::string(info.param.name); });

}  // namespace
}  // namespace catalogue
