// A child process works on a catalogue through the main window and the new-list dialog without
// pause and is killed at a random moment, over and over. After every kill the program's start-up
// must find a catalogue that loads whole.
#include <gtest/gtest.h>
#include <sys/mman.h>

#include <chrono>
#include <iostream>
#include <random>

#include "catalogue/file_text.h"
#include "catalogue/records.h"
#include "tests/faults/fault_rig.h"

namespace faults {
namespace {

using ui::Answer;

constexpr unsigned kSeed = 20240607;
constexpr auto kBudget = std::chrono::milliseconds(2000);

// One child's work: random operations on random lists until it is killed. Titles and names carry
// the round and a serial number, so none is ever refused as taken. An error box ends the child
// before it is killed.
void work(const std::string& folder, unsigned seed, int round, long* done) {
    Rig r(folder);
    r.start();
    std::mt19937 rng(seed);
    const auto pick = [&](const std::vector<std::string>& items) {
        return items[rng() % items.size()];
    };
    for (int serial = 0;; ++serial, ++*done) {
        const std::string tag = std::to_string(round) + "-" + std::to_string(serial);
        const std::string title = std::string(1, "ABCDEFGHIJKLMNOPQRSTUVWXYZ1"[rng() % 27]) + tag;
        const std::vector<std::string> lists = r.view.List_list.items();
        r.open(pick(lists));
        const std::vector<std::string> titles = r.view.List1.items();
        const unsigned what = rng() % 10;
        if (what < 4) {
            r.fill({title, "Game", "1", "Copy"});
            r.view.Command_add.click();
        } else if (what < 6 && r.select(pick(titles))) {
            r.platform.answer(Answer::Yes);
            r.fill({title, "DVD video", "2", "Original"});
            r.view.Command_change.click();
        } else if (what < 8 && r.select(pick(titles))) {
            r.platform.answer(Answer::Yes);
            r.view.Command_delentry.click();
        } else if (what == 8 && lists.size() < 6) {
            r.createList("L" + tag);
        } else if (what == 9) {
            r.platform.answer(Answer::Yes);
            r.platform.answer(Answer::Yes);
            r.view.Command_delete.click();
        }
        if (!r.errors().empty()) throw std::runtime_error(r.errors().front().prompt);
    }
}

// Every line ends with CR LF and none is empty.
bool tidy(const std::string& bytes) {
    for (std::string_view line : catalogue::splitLines(bytes)) {
        if (line.empty() || line.find('\n') != std::string_view::npos) return false;
    }
    return bytes.empty() || bytes.ends_with("\r\n");
}

// What start-up after a kill must find: every list opens, with whole entries and one article
// line per title, and nothing half-done left in the folder.
void expectWhole(const std::string& folder) {
    catalogue::Store(folder).recover();
    const Files files = snapshot(folder);
    EXPECT_FALSE(hasLeftovers(files));
    Rig r(folder);
    r.start();
    EXPECT_TRUE(tidy(files.at("pemla.dat")));
    const std::vector<std::string> lists = r.view.List_list.items();
    EXPECT_FALSE(lists.empty());
    for (const std::string& list : lists) {
        SCOPED_TRACE(list);
        EXPECT_TRUE(r.open(list));
        if (!r.errors().empty()) {
            ADD_FAILURE() << r.errors().front().prompt;
            return;
        }
        const std::vector<std::string> titles = r.view.List1.items();
        const std::string& entries = files.at(catalogue::entryFile(list));
        const std::string& articles = files.at(catalogue::articleFile(list));
        EXPECT_TRUE(tidy(entries) && tidy(articles) &&
                    tidy(files.at(catalogue::counterFile(list))));
        EXPECT_EQ(catalogue::splitLines(entries).size(), 4 * titles.size());
        EXPECT_EQ(catalogue::splitLines(articles).size(), titles.size());
        for (const std::string& title : titles) {
            EXPECT_NE(catalogue::findArticleLine(catalogue::toFileText(articles), title),
                      std::string::npos)
                << title;
        }
    }
}

TEST(Soak, KilledAtRandomMomentsTheCatalogueAlwaysStartsWhole) {
    Rig base;
    base.putRock();
    // The children count their finished operations here.
    void* shared =
        ::mmap(nullptr, sizeof(long), PROT_READ | PROT_WRITE, MAP_SHARED | MAP_ANONYMOUS, -1, 0);
    ASSERT_NE(shared, MAP_FAILED);
    long* done = static_cast<long*>(shared);
    *done = 0;
    std::mt19937 rng(kSeed);
    const auto start = std::chrono::steady_clock::now();
    int kills = 0, midway = 0;
    while (std::chrono::steady_clock::now() - start < kBudget && !HasFailure()) {
        const unsigned seed = rng();
        const int delay = 1 + static_cast<int>(rng() % 50);
        const int status = inChild([&] { work(base.folder.path(), seed, kills, done); }, delay);
        ASSERT_TRUE(killed(status)) << "round " << kills << ", wait status " << status;
        ++kills;
        // A kill in the middle of a commit leaves its staged files or journal behind.
        midway += hasLeftovers(snapshot(base.folder.path())) ? 1 : 0;
        expectWhole(base.folder.path());
    }
    std::cout << "[ faults ] soak (seed " << kSeed << "): " << kills << " kills (" << midway
              << " in the middle of a commit) over " << *done << " finished operations\n";
    EXPECT_GT(kills, 10);
    EXPECT_GT(midway, 0);
    EXPECT_GT(*done, kills);
    ::munmap(shared, sizeof(long));
}

}  // namespace
}  // namespace faults
