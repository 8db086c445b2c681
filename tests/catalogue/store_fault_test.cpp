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

using test_support::FaultySys;
using test_support::SysCall;

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
    std::map<std::string, std::optional<std::string>> changes;  // nothing: delete
};
void PrintTo(const Row& row, std::ostream* out) {
    *out << row.name;
}

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

class CommitFaults : public ::testing::TestWithParam<Row> {
  protected:
    void SetUp() override {
        newSet = kOld;
        for (const auto& [name, content] : GetParam().changes) {
            if (content)
                newSet[name] = *content;
            else
                newSet.erase(name);
        }
    }
    void commit(Store& store) {
        Transaction t = store.begin();
        for (const auto& [name, content] : GetParam().changes) {
            if (content)
                t.write(name, *content);
            else
                t.remove(name);
        }
        t.commit();
    }
    void reset() {
        for (const auto& item : std::filesystem::directory_iterator(folder.path())) {
            std::filesystem::remove(item.path());
        }
        for (const auto& [name, bytes] : kOld) folder.put(name, bytes);
    }
    Files state() const {
        Files files;
        for (const auto& item : std::filesystem::directory_iterator(folder.path())) {
            files[item.path().filename()] = folder.get(item.path().filename().string());
        }
        return files;
    }
    // Prints the points covered, per kind, to the log and the test report.
    int report(const std::string& what, const std::map<std::string, int>& points) {
        int total = 0;
        std::string line;
        for (const auto& [kind, n] : points) line += " " + kind + "=" + std::to_string(n);
        for (const auto& item : points) total += item.second;
        std::cout << GetParam().name << ": " << total << " " << what << " covered:" << line << "\n";
        RecordProperty(what, total);
        return total;
    }

    test_support::TempFolder folder;
    Files newSet;
};

// Each system call of the commit fails in turn (the kinds of kAllSysCalls), then the commit is
// stopped dead at each step in turn (the last round).
TEST_P(CommitFaults, AFailingCallOrACrashLeavesTheOldOrTheNewSet) {
    std::map<std::string, int> points, outcomes;
    for (std::size_t round = 0; round <= test_support::kAllSysCalls.size(); ++round) {
        const bool crash = round == test_support::kAllSysCalls.size();
        const SysCall kind = crash ? SysCall::Open : test_support::kAllSysCalls[round];
        const int errnum = kind == SysCall::Write ? ENOSPC : EIO;
        for (int n = 1;; ++n) {
            SCOPED_TRACE(crash ? "crash at step " + std::to_string(n)
                               : std::string(sysCallName(kind)) + " #" + std::to_string(n));
            reset();
            FaultySys sys;
            sys.capWrites(16);  // several writes per file, so a write can fail half-way
            if (crash)
                sys.crashAt(n);
            else
                sys.failAt(kind, n, errnum);
            Store store(folder.path(), sys);
            bool threw = false;
            try {
                commit(store);
            } catch (const CatalogueError& e) {
                threw = true;
                EXPECT_FALSE(crash) << "a crash taken for a failure";
                EXPECT_EQ(e.reason(), std::strerror(errnum));
                EXPECT_FALSE(e.file().empty());
            } catch (const test_support::CrashStop&) {
                EXPECT_TRUE(crash);
            }
            if (!sys.fired()) {
                EXPECT_FALSE(threw);
                EXPECT_EQ(state(), newSet);
                break;
            }
            // A failure leaves a whole set, with no staged file or journal, even before recovery.
            if (!crash) {
                EXPECT_EQ(state(), threw ? kOld : newSet) << (threw ? "threw" : "returned");
            }
            Store real(folder.path());
            real.recover();
            const Files after = state();
            if (crash && (after == kOld || after == newSet)) {
                ++outcomes[after == kOld ? "all old" : "all new"];
            } else if (crash) {
                ADD_FAILURE() << "mixed set after recovery";
            } else {
                ++points[sysCallName(kind)];
                EXPECT_EQ(after, threw ? kOld : newSet) << (threw ? "threw" : "returned");
            }
            // The same change again, on the same store unless that one was stopped dead.
            commit(crash ? real : store);
            EXPECT_EQ(state(), newSet);
        }
    }
    // At least the staging or removal and the folder flush of every file were hit.
    EXPECT_GE(report("fault points", points), static_cast<int>(4 * GetParam().changes.size()));
    report("crash points", outcomes);
    EXPECT_GT(outcomes["all old"], 0);
    EXPECT_GT(outcomes["all new"], 0);
}

INSTANTIATE_TEST_SUITE_P(Store, CommitFaults, ::testing::ValuesIn(kRows),
                         [](const auto& info) { return std::string(info.param.name); });

}  // namespace
}  // namespace catalogue
