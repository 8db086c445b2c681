#include "catalogue/store.h"

#include <gtest/gtest.h>
#include <sys/stat.h>

#include <cerrno>
#include <cstring>
#include <filesystem>

#include "catalogue/catalogue_error.h"
#include "tests/support/faulty_sys.h"
#include "tests/support/temp_folder.h"

namespace catalogue {
namespace {

using test_support::FaultySys;
using test_support::SysCall;
using test_support::TempFolder;

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

TEST_F(StoreTest, Reads) {
    folder.put("Rock.dat", "<|?A\r\n<|'CD\rlone\nLF\r\n");
    folder.put("Rock.inf", " 1 \r\n");
    folder.put("Bad.inf", "x\r\n");
    EXPECT_EQ(store.readText("Rock.dat"), "<|?A\r\n<|'CD\r\nlone\nLF\r\n");
    EXPECT_EQ(store.readLines("Rock.dat"), (std::vector<std::string>{"<|?A", "<|'CD", "lone\nLF"}));
    EXPECT_EQ(store.readNumber("Rock.inf"), 1);
    EXPECT_EQ(store.readNumber("Bad.inf"), std::nullopt);
    EXPECT_EQ(store.readTextIfExists("Rock.inf"), " 1 \r\n");
    EXPECT_EQ(store.readTextIfExists("Rock.top"), std::nullopt);
    EXPECT_TRUE(store.exists("Rock.dat"));
    EXPECT_FALSE(store.exists("Rock.top"));

    folder.put("empty.dat", "");
    EXPECT_EQ(store.readText("empty.dat"), "");
    EXPECT_TRUE(store.readLines("empty.dat").empty());
    // Larger than one read buffer, with bytes of every value.
    std::string big;
    for (int i = 0; i < 300000; ++i)
        big.push_back(static_cast<char>(i % 251 == 13 ? 'x' : i % 251));
    folder.put("big.dat", big);
    EXPECT_EQ(store.readBytes("big.dat"), big);
}

TEST_F(StoreTest, ReadErrorsNameTheFileAndTheReason) {
    expectError([&] { store.readText("Missing.dat"); }, "Missing.dat", ENOENT);
    expectError([&] { store.readLines("Missing.dat"); }, "Missing.dat", ENOENT);
    expectError([&] { store.readNumber("Missing.inf"); }, "Missing.inf", ENOENT);
    std::filesystem::create_directory(folder.file("Folder.dat"));
    expectError([&] { store.readText("Folder.dat"); }, "Folder.dat", EISDIR);
    expectError([&] { store.readTextIfExists("Folder.dat"); }, "Folder.dat", EISDIR);
}

TEST_F(StoreTest, TransactionWritesEveryFileAndTheLastPlanWins) {
    folder.put("Rock.dat", "old\r\n");
    folder.put("Rock.inf", " 1 \r\n");
    folder.put("Gone.dat", "x\r\n");
    Transaction t = store.begin();
    t.write("Rock.dat", "<|?A\r\n<|'CD");
    t.write("Rock.art", "A#*\\A001\r\n");
    t.write("Rock.arn", "first");
    t.remove("Gone.dat");
    t.remove("Never.dat");  // missing already: no error
    t.write("Rock.arn", "A#002\r\n");
    t.write("Gone.dat", "back\r\n");
    t.remove("Rock.inf");
    t.write("Empty.dat", "");
    t.commit();
    EXPECT_EQ(folder.listing(), "Empty.dat\nGone.dat\nRock.arn\nRock.art\nRock.dat\n");
    EXPECT_EQ(folder.get("Rock.dat"), "<|?A\r\n<|'CD\r\n");
    EXPECT_EQ(folder.get("Rock.art"), "A#*\\A001\r\n");
    EXPECT_EQ(folder.get("Rock.arn"), "A#002\r\n");
    EXPECT_EQ(folder.get("Gone.dat"), "back\r\n");
    EXPECT_EQ(folder.get("Empty.dat"), "");

    store.begin().commit();  // nothing planned, nothing done
    Transaction one = store.begin();
    one.write("Add one & delete me!.dat", "x");
    one.commit();
    EXPECT_EQ(folder.get("Add one & delete me!.dat"), "x\r\n");
    Transaction del = store.begin();
    del.remove("Empty.dat");
    del.commit();
    EXPECT_FALSE(folder.has("Empty.dat"));
}

TEST_F(StoreTest, AProtectedFileIsRefusedAndLeftAlone) {
    folder.put("Rock.dat", "old dat\r\n");
    folder.put("Rock.art", "old art\r\n");
    folder.put("Rock.inf", " 1 \r\n");
    const std::string before = folder.listing();
    // The refusal goes by the permission bits, so it holds for root as well.
    for (const char* locked : {"Rock.art", "Rock.inf"}) {
        SCOPED_TRACE(locked);
        ::chmod(folder.file(locked).c_str(), 0444);
        Transaction t = store.begin();
        t.write("Rock.dat", "new dat");
        t.write("Rock.art", "new art");
        t.remove("Rock.inf");
        expectError([&] { t.commit(); }, locked, EACCES);
        EXPECT_EQ(folder.get("Rock.dat"), "old dat\r\n");
        EXPECT_EQ(folder.get("Rock.art"), "old art\r\n");
        EXPECT_EQ(folder.get("Rock.inf"), " 1 \r\n");
        EXPECT_EQ(folder.listing(), before);
        ::chmod(folder.file(locked).c_str(), 0644);
    }
    ::chmod(folder.file("Rock.dat").c_str(), 0444);
    Transaction single = store.begin();
    single.write("Rock.dat", "new");
    expectError([&] { single.commit(); }, "Rock.dat", EACCES);
    EXPECT_EQ(folder.get("Rock.dat"), "old dat\r\n");
    EXPECT_EQ(folder.listing(), before);
}

TEST_F(StoreTest, WriteFileAtomicallyReplacesTheFile) {
    const std::string report = folder.file("Rock.TXT");
    writeFileAtomically(report, "first\r\n");
    EXPECT_EQ(folder.get("Rock.TXT"), "first\r\n");
    writeFileAtomically(report, "second, not changed: no CR LF added");
    EXPECT_EQ(folder.get("Rock.TXT"), "second, not changed: no CR LF added");
    EXPECT_EQ(folder.listing(), "Rock.TXT\n");

    FaultySys shortWrites;
    shortWrites.capWrites(3);
    writeFileAtomically(report, "written three bytes at a time\r\n", shortWrites);
    EXPECT_EQ(folder.get("Rock.TXT"), "written three bytes at a time\r\n");
    EXPECT_GT(shortWrites.calls(SysCall::Write), 10);

    ::chmod(report.c_str(), 0444);
    expectError([&] { writeFileAtomically(report, "x"); }, "Rock.TXT", EACCES);
    EXPECT_EQ(folder.get("Rock.TXT"), "written three bytes at a time\r\n");
    ::chmod(report.c_str(), 0644);

    // A staged copy left by a write that was stopped dead is cleared by the next write of the
    // same report; other files, the user's own included, stay.
    folder.put("Rock.TXT.4242.pemla-tmp", "stale");
    folder.put("Rock.TXT.mine.pemla-tmp", "not ours");
    folder.put("Pop.TXT.4242.pemla-tmp", "another report's");
    writeFileAtomically(report, "third\r\n");
    EXPECT_EQ(folder.listing(), "Pop.TXT.4242.pemla-tmp\nRock.TXT\nRock.TXT.mine.pemla-tmp\n");
}

TEST_F(StoreTest, WriteFileAtomicallyKeepsTheOldFileOnFailure) {
    const std::string old = "old report\r\n";
    folder.put("Rock.html", old);
    const std::string big(200000, 'r');
    struct Case {
        SysCall kind;
        int n;
        int errnum;
    };
    for (Case c : {Case{SysCall::Open, 1, EACCES}, Case{SysCall::Write, 1, ENOSPC},
                   Case{SysCall::Write, 2, EIO}, Case{SysCall::Fsync, 1, EIO},
                   Case{SysCall::Close, 1, EIO}, Case{SysCall::Rename, 1, EXDEV}}) {
        SCOPED_TRACE(std::string(sysCallName(c.kind)) + " #" + std::to_string(c.n));
        FaultySys sys;
        sys.capWrites(big.size() / 2);
        sys.failAt(c.kind, c.n, c.errnum);
        expectError([&] { writeFileAtomically(folder.file("Rock.html"), big, sys); }, "Rock.html",
                    c.errnum);
        EXPECT_TRUE(sys.fired());
        EXPECT_EQ(folder.get("Rock.html"), old);
        EXPECT_EQ(folder.listing(), "Rock.html\n");
    }
}

}  // namespace
}  // namespace catalogue
