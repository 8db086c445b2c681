#include "catalogue/journal.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <vector>

#include "catalogue/catalogue_error.h"
#include "catalogue/store.h"
#include "tests/support/faulty_sys.h"
#include "tests/support/temp_folder.h"

namespace catalogue {
namespace {

using test_support::FaultySys;
using test_support::SysCall;
using test_support::TempFolder;

const JournalPlan kPlan{{{"Rock.dat.1-1.pemla-tmp", "Rock.dat"},
                         {"Rock & Pop \xE9.art.1-2.pemla-tmp", "Rock & Pop \xE9.art"}},
                        {"Rock.inf", "END 12"}};

TEST(Journal, RoundTrip) {
    const auto plan = decodeJournal(encodeJournal(kPlan));
    ASSERT_TRUE(plan);
    EXPECT_EQ(plan->renames, kPlan.renames);
    EXPECT_EQ(plan->deletions, kPlan.deletions);
    const auto empty = decodeJournal(encodeJournal({}));
    ASSERT_TRUE(empty);
    EXPECT_TRUE(empty->renames.empty() && empty->deletions.empty());
}

TEST(Journal, TornOrDamagedJournalsReadAsNothing) {
    const std::string bytes = encodeJournal(kPlan);
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
    EXPECT_FALSE(decodeJournal(bytes + bytes));
}

TEST(Journal, OnlyPlainNamesOfTheFolder) {
    for (const std::string& bad : std::vector<std::string>{"../Rock.dat", "/etc/passwd", "a/b", ".",
                                                           "..", std::string("a\0b", 3)}) {
        EXPECT_FALSE(decodeJournal(encodeJournal({{{"x.pemla-tmp", bad}}, {}}))) << bad;
        EXPECT_FALSE(decodeJournal(encodeJournal({{{bad, "x.dat"}}, {}}))) << bad;
        EXPECT_FALSE(decodeJournal(encodeJournal({{}, {bad}}))) << bad;
    }
    EXPECT_FALSE(decodeJournal(encodeJournal({{}, {""}})));
}

// A commit stopped after its journal was complete: one target renamed, one not yet.
struct HalfDone : ::testing::Test {
    void SetUp() override {
        folder.put("a.dat", "a new\r\n");  // already renamed from its staged file
        folder.put("b.dat", "b old\r\n");
        folder.put("b.dat.9-2.pemla-tmp", "b new\r\n");
        folder.put("c.dat", "c old\r\n");
        plan = {{{"a.dat.9-1.pemla-tmp", "a.dat"}, {"b.dat.9-2.pemla-tmp", "b.dat"}}, {"c.dat"}};
    }
    TempFolder folder;
    JournalPlan plan;
};

TEST_F(HalfDone, RecoveryFinishesACompleteJournal) {
    folder.put(kJournalName, encodeJournal(plan));
    Store(folder.path()).recover();
    EXPECT_EQ(folder.listing(), "a.dat\nb.dat\n");
    EXPECT_EQ(folder.get("a.dat"), "a new\r\n");
    EXPECT_EQ(folder.get("b.dat"), "b new\r\n");
    Store(folder.path()).recover();  // again: nothing left to do
    EXPECT_EQ(folder.listing(), "a.dat\nb.dat\n");
}

TEST_F(HalfDone, RecoveryDropsATornJournalWithItsStagedFiles) {
    const std::string bytes = encodeJournal(plan);
    folder.put(kJournalName, bytes.substr(0, bytes.size() - 3));
    Store(folder.path()).recover();
    EXPECT_EQ(folder.listing(), "a.dat\nb.dat\nc.dat\n");
    EXPECT_EQ(folder.get("b.dat"), "b old\r\n");
}

TEST_F(HalfDone, AJournalThatCannotBeReadIsKeptForLater) {
    folder.put(kJournalName, encodeJournal(plan));
    for (SysCall kind : {SysCall::Open, SysCall::Read}) {
        FaultySys sys;
        sys.failAt(kind, 1, EIO);
        Store store(folder.path(), sys);
        EXPECT_THROW(store.recover(), CatalogueError) << sysCallName(kind);
        EXPECT_TRUE(sys.fired());
        // Dropping it now would leave a.dat new and b.dat old for good.
        EXPECT_TRUE(folder.has(kJournalName)) << sysCallName(kind);
        EXPECT_TRUE(folder.has("b.dat.9-2.pemla-tmp")) << sysCallName(kind);
    }
    Store(folder.path()).recover();
    EXPECT_EQ(folder.listing(), "a.dat\nb.dat\n");
    EXPECT_EQ(folder.get("b.dat"), "b new\r\n");
}

}  // namespace
}  // namespace catalogue
