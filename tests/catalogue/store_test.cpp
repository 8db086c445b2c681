#include "catalogue/store.h"

#include <gtest/gtest.h>
#include <signal.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>
#include <filesystem>
#include <vector>

#include "catalogue/catalogue_error.h"
#include "catalogue/folder_lock.h"
#include "catalogue/journal.h"
#include "tests/support/faulty_sys.h"
#include "tests/support/temp_folder.h"

namespace catalogue {
namespace {

using namespace test_support;  // folders and failing system calls

// Runs `f`, expecting a CatalogueError for `file` with the OS reason of `errnum`.
template <typename F>
void expectError(F f, const std::string& file, int errnum) {
    try {
        f();
        ADD_FAILURE() << "no error for " << file;
    } catch (const CatalogueError& e) {
        EXPECT_EQ(e.file(), file);
        EXPECT_EQ(e.reason(), std::strerror(errnum));
        EXPECT_NE(std::string(e.what()).find(file), std::string::npos);
    }
}

struct StoreTest : ::testing::Test {
    TempFolder folder;
    Store store{folder.path()};
};

TEST_F(StoreTest, ReadsAndNamesTheFileAndReasonOfAFailedRead) {
    folder.put("Rock.dat", "<|?A\r\n<|'CD\rlone\nLF\r\n");
    folder.put("Rock.inf", " 1 \r\n");
    EXPECT_EQ(store.readText("Rock.dat"), "<|?A\r\n<|'CD\r\nlone\nLF\r\n");
    EXPECT_EQ(store.readLines("Rock.dat"), (std::vector<std::string>{"<|?A", "<|'CD", "lone\nLF"}));
    EXPECT_EQ(store.readNumber("Rock.inf"), 1);
    EXPECT_EQ(store.readTextIfExists("Rock.inf"), " 1 \r\n");
    EXPECT_EQ(store.readTextIfExists("Rock.top"), std::nullopt);
    EXPECT_TRUE(store.exists("Rock.dat") && !store.exists("Rock.top"));

    expectError([&] { store.readNumber("Missing.inf"); }, "Missing.inf", ENOENT);
    std::filesystem::create_directory(folder.file("Folder.dat"));
    expectError([&] { store.readText("Folder.dat"); }, "Folder.dat", EISDIR);
    expectError([&] { store.readTextIfExists("Folder.dat"); }, "Folder.dat", EISDIR);
}

// Replacing a report, and its failed calls where the files show them, are the report sweep's in
// the fault tests. Here the bytes go as they are, in short pieces if need be; stale copies of its
// own go; a read-only report is not replaced; and a failed flush or close, which the files alone
// would not show, is reported and keeps the old report.
TEST_F(StoreTest, AtomicWriteTakesShortWritesClearsStaleCopiesAndReportsFailedFlushes) {
    const std::string report = folder.file("Rock.TXT");
    FaultySys shortWrites;
    shortWrites.capWrites(3);
    writeFileAtomically(report, "written three bytes at a time\r\n", shortWrites);
    EXPECT_EQ(folder.get("Rock.TXT"), "written three bytes at a time\r\n");
    EXPECT_GT(shortWrites.calls(SysCall::Write), 10);

    // A staged copy left by a write that was stopped dead is cleared by the next write of the
    // same report; other files, the user's own included, stay.
    folder.put("Rock.TXT.4242.pemla-tmp", "stale");
    folder.put("Rock.TXT.mine.pemla-tmp", "not ours");
    folder.put("Pop.TXT.4242.pemla-tmp", "another report's");
    writeFileAtomically(report, "third, as it is: no CR LF added");
    EXPECT_EQ(folder.get("Rock.TXT"), "third, as it is: no CR LF added");
    EXPECT_EQ(folder.listing(), "Pop.TXT.4242.pemla-tmp\nRock.TXT\nRock.TXT.mine.pemla-tmp\n");
    // A report its owner made read-only is not replaced.
    ::chmod(report.c_str(), 0444);
    expectError([&] { writeFileAtomically(report, "x"); }, "Rock.TXT", EACCES);
    ::chmod(report.c_str(), 0644);
    for (const SysCall kind : {SysCall::Fsync, SysCall::Close}) {
        FaultySys sys;
        sys.failNext(kind, 1, EIO);
        expectError([&] { writeFileAtomically(report, "fourth\r\n", sys); }, "Rock.TXT", EIO);
        EXPECT_EQ(folder.get("Rock.TXT"), "third, as it is: no CR LF added") << sysCallName(kind);
    }
}

const JournalPlan kPlan{{{"Rock.dat.1-1.pemla-tmp", "Rock.dat"},
                         {"Rock & Pop \xE9.art.1-2.pemla-tmp", "Rock & Pop \xE9.art"}},
                        {"Rock.inf", "END 12"},
                        {"Rock.del", "/out/Rock.TXT.77.pemla-tmp"}};

TEST(Journal, RoundTripsAndReadsATornOrDamagedJournalAsNothing) {
    const std::string bytes = encodeJournal(kPlan);
    const auto plan = decodeJournal(bytes);
    ASSERT_TRUE(plan);
    EXPECT_EQ(plan->renames, kPlan.renames);
    EXPECT_EQ(plan->deletions, kPlan.deletions);
    EXPECT_EQ(plan->strays, kPlan.strays);
    for (std::size_t n = 0; n < bytes.size(); ++n) {
        EXPECT_FALSE(decodeJournal(bytes.substr(0, n))) << "prefix of " << n;
    }
    for (std::size_t i = 0; i < bytes.size(); ++i) {
        for (unsigned char flip : {0x01, 0x20, 0x80}) {
            std::string damaged = bytes;
            damaged[i] = static_cast<char>(damaged[i] ^ flip);
            EXPECT_FALSE(decodeJournal(damaged)) << "byte " << i << " ^ " << int(flip);
        }
    }
    EXPECT_FALSE(decodeJournal(bytes + "x"));
}

// Strays, which are removed without a question, are probes or staged copies and nothing else.
TEST(Journal, OnlyPlainNamesOfTheFolder) {
    for (const std::string& bad : std::vector<std::string>{"../Rock.dat", "/etc/passwd", "a/b", ".",
                                                           "..", std::string("a\0b", 3), ""}) {
        EXPECT_FALSE(decodeJournal(encodeJournal({{{"x.pemla-tmp", bad}}, {}, {}}))) << bad;
        EXPECT_FALSE(decodeJournal(encodeJournal({{{bad, "x.dat"}}, {}, {}}))) << bad;
        EXPECT_FALSE(decodeJournal(encodeJournal({{}, {bad}, {}}))) << bad;
        EXPECT_FALSE(decodeJournal(encodeJournal({{}, {}, {bad}}))) << bad;
    }
    for (const char* bad : {"Rock.dat", "a.pemla-tmp", "/a/../b.pemla-tmp", "/x.del"}) {
        EXPECT_FALSE(decodeJournal(encodeJournal({{}, {}, {bad}}))) << bad;
    }
}

// A commit stopped after its journal was complete: a.dat renamed already, b.dat not yet, and
// c.dat still to delete. `journal` is what is left of the journal.
void putHalfDone(const TempFolder& folder, std::string_view journal) {
    folder.put("a.dat", "a new\r\n");
    folder.put("b.dat", "b old\r\n");
    folder.put("b.dat.9-2.pemla-tmp", "b new\r\n");
    folder.put("c.dat", "c old\r\n");
    folder.put(kJournalName, journal);
}

const std::string kHalfDone = encodeJournal(
    {{{"a.dat.9-1.pemla-tmp", "a.dat"}, {"b.dat.9-2.pemla-tmp", "b.dat"}}, {"c.dat"}, {}});

TEST(Recovery, FinishesACompleteJournalAndDropsATornOneWithItsStagedFiles) {
    TempFolder done, torn;
    putHalfDone(done, kHalfDone);
    putHalfDone(torn, kHalfDone.substr(0, kHalfDone.size() - 3));
    for (int twice = 0; twice < 2; ++twice) {  // the second run finds nothing left to do
        Store(done.path()).recover();
        EXPECT_EQ(done.listing(), "a.dat\nb.dat\n");
        EXPECT_EQ(done.get("a.dat") + done.get("b.dat"), "a new\r\nb new\r\n");
    }
    Store(torn.path()).recover();
    EXPECT_EQ(torn.listing(), "a.dat\nb.dat\nc.dat\n");
    EXPECT_EQ(torn.get("b.dat"), "b old\r\n");
}

// Left half done after the transaction began, by another one that failed meanwhile.
TEST_F(StoreTest, ACommitFinishesAChangeLeftHalfDoneBeforeItsOwn) {
    Transaction t = store.begin();
    putHalfDone(folder, kHalfDone);
    t.write("b.dat", "b newer\r\n");
    t.commit();
    EXPECT_EQ(folder.listing(), "a.dat\nb.dat\n");
    EXPECT_EQ(folder.get("a.dat") + folder.get("b.dat"), "a new\r\nb newer\r\n");
}

TEST_F(StoreTest, AJournalThatCannotBeReadIsKeptForLater) {
    putHalfDone(folder, kHalfDone);
    for (SysCall kind : {SysCall::Open, SysCall::Read}) {
        FaultySys sys;
        sys.failNext(kind, 1, EIO);
        EXPECT_THROW(Store(folder.path(), sys).recover(), CatalogueError) << sysCallName(kind);
        // Dropping it now would leave a.dat new and b.dat old for good.
        EXPECT_EQ(folder.listing(), std::string("a.dat\nb.dat\nb.dat.9-2.pemla-tmp\nc.dat\n") +
                                        std::string(kJournalName) + "\n");
    }

    // A torn journal that cannot be removed is reported, not passed over.
    putHalfDone(folder, kHalfDone.substr(0, kHalfDone.size() - 3));
    FaultySys sys;
    sys.failNext(SysCall::Unlink, 1, EIO);
    EXPECT_THROW(Store(folder.path(), sys).recover(), CatalogueError);
    EXPECT_TRUE(folder.has(kJournalName));
}

// The lock lives as long as the process holding it, however that process ends.
TEST_F(StoreTest, TheFolderLockIsHeldByOneProcessUntilItIsKilled) {
    int ready[2];
    ASSERT_EQ(::pipe(ready), 0);
    const pid_t holder = ::fork();
    if (holder == 0) {
        // Whether it holds the lock shows in the other process's state below.
        FolderLock lock(folder.path());
        (void)::write(ready[1], "y", 1);
        ::pause();
        ::_exit(0);
    }
    char locked = 0;
    ASSERT_EQ(::read(ready[0], &locked, 1), 1);
    EXPECT_EQ(FolderLock(folder.path()).state(), FolderLock::State::Taken);
    ::kill(holder, SIGKILL);
    ::waitpid(holder, nullptr, 0);
    EXPECT_EQ(FolderLock(folder.path()).state(), FolderLock::State::Held);
    // Where no lock file can be made the program runs unlocked rather than not at all.
    EXPECT_EQ(FolderLock(folder.file("missing")).state(), FolderLock::State::Unlocked);
    ::close(ready[0]);
    ::close(ready[1]);
}

}  // namespace
}  // namespace catalogue
