// A list at its largest: 32767 entries of about 100 bytes. The list is full, and opening,
// selecting, adding, changing and deleting each stay well under a quarter of a second.
#include <chrono>
#include <cstdio>

#include "tests/main_window/form1_test_fixture.h"

namespace main_window_test {
namespace {

constexpr int kFull = 32767;

std::string titleOf(int i) {
    char title[32];
    std::snprintf(title, sizeof title, "%c%05d Recording", 'A' + i % 26, i);
    return title;
}

// Runs `action` and prints how long it took; in an optimised build it must stay under a second.
template <typename Action>
void timed(const char* what, Action action) {
    const auto start = std::chrono::steady_clock::now();
    action();
    const auto ms =
        std::chrono::duration<double, std::milli>(std::chrono::steady_clock::now() - start).count();
    std::printf("[   TIME   ] %s with %d entries: %.1f ms\n", what, kFull, ms);
#ifdef NDEBUG
    // The benchmark measures the real figures; this bound only catches work that grows with the
    // square of the list, and leaves room for a slow disk's fsync.
    EXPECT_LT(ms, 1000.0) << what;
#endif
}

TEST_F(Form1Test, AFullListRefusesAnAddAndEveryOperationOnItIsQuick) {
    std::vector<Item> items;
    std::vector<Art> art;
    for (int i = 0; i < kFull; ++i) {
        items.push_back({titleOf(i), "Music CD", std::to_string(i % 10 + 1),
                         "Original pressing with booklet, sleeve notes and poster"});
        art.push_back({titleOf(i), std::string(1, 'A' + i % 26) + "001"});
    }
    putList("Big", entries(items), articles(art));
    folder.put("pemla.dat", crlf({"Big"}));
    start();

    timed("open", [&] { open("Big"); });
    ASSERT_EQ(view.List1.count(), kFull);
    const Files before = snapshot();
    fill({"One too many", "CD", "1", ""});
    platform.answer(Answer::Ok);
    view.Command_add.click();
    expectBox(0, 16, "Error", "This list is full: a list holds at most 32767 titles.");
    EXPECT_EQ(snapshot(), before);

    const int middle = kFull / 2;
    timed("select", [&] { select(titleOf(middle)); });
    EXPECT_EQ(view.Textart.text(), art[middle].number);
    retype(view.Combo1, "Vinyl");
    platform.answer(Answer::Yes);
    timed("change", [&] { view.Command_change.click(); });
    items[middle].type = "Vinyl";

    select(titleOf(middle + 1));
    platform.answer(Answer::Yes);
    timed("delete", [&] { view.Command_delentry.click(); });
    items.erase(items.begin() + middle + 1);
    art.erase(art.begin() + middle + 1);
    EXPECT_EQ(view.Label2.caption(), "... amount:  32766 ...");

    fill({"Zz last one", "CD", "1", ""});
    timed("add", [&] { view.Command_add.click(); });
    items.push_back({"Zz last one", "CD", "1", ""});
    art.push_back({"Zz last one", "Z001"});
    expectList("Big", entries(items), articles(art), "A#001\r\nZ#002\r\n");
    EXPECT_EQ(view.Label2.caption(), "... amount:  32767 ...");
    EXPECT_EQ(platform.shown().size(), 3u);
}

}  // namespace
}  // namespace main_window_test
