#pragma once

#include <gtest/gtest.h>

#include <filesystem>
#include <map>
#include <string>
#include <vector>

#include "catalogue/folder_lock.h"
#include "tests/support/memory_form1.h"

// The main window's tests: a catalogue folder with the list "Rock", literal file contents built
// line by line, typing into the entry fields, and snapshots that prove nothing was written.
namespace main_window_test {

using Strings = std::vector<std::string>;
using Files = std::map<std::string, std::string>;
using ui::Answer;

// Lines, each followed by CR LF: what every file the program writes looks like.
inline std::string crlf(const Strings& lines) {
    std::string text;
    for (const std::string& line : lines) text += line + "\r\n";
    return text;
}

struct Item {
    std::string title, type, discs, info;
};

// Entries as the entry file holds them, four tagged lines each.
inline std::string entries(const std::vector<Item>& items) {
    std::string text;
    for (const Item& e : items)
        text += crlf({"<|?" + e.title, "<|'" + e.type, "<||" + e.discs, "<|*" + e.info});
    return text;
}

struct Art {
    std::string title, number;
};

inline std::string articles(const std::vector<Art>& lines) {
    std::string text;
    for (const Art& a : lines) text += a.title + "#*\\" + a.number + "\r\n";
    return text;
}

inline const std::string kSkeletonDat =
    "<|?Add an item and delete me!\r\n<|'DELETE ME!\r\n<||DELETE ME!\r\n<|*DELETE ME!\r\n";
inline const std::string kSkeletonArt = "Add an item and delete me!#*\\A001\r\n";
inline const std::string kPlaceholderList = "Add one & delete me!";

class Form1Test : public ::testing::Test, public test_support::MainWindowFixture {
  protected:
    // "Rock" in the order its entries were added; List1 shows 1st, abc, abcd, xabc, Zebra.
    // "abcd" stands before "abc" and "xabc" ends with "abc", in both files.
    const std::vector<Item> rock = {{"Zebra", "CD", "1", "Original"},
                                    {"abcd", "DVD", "2", "Copy"},
                                    {"abc", "Game", "3", ""},
                                    {"xabc", "CD", "10", "x"},
                                    {"1st", "LP", "1", "Original"}};
    const std::vector<Art> rockArt = {
        {"xabc", "X001"}, {"abcd", "A001"}, {"Zebra", "Z001"}, {"1st", "!001"}, {"abc", "A002"}};
    const std::string rockArn = crlf({"A#003", "Z#002", "X#002", "!#002"});

    // Puts "Rock" (and the given other lists, as skeletons) into the folder and the index.
    void putRock(const Strings& others = {}) {
        putList("Rock", entries(rock), articles(rockArt), rockArn);
        Strings index = {"Rock"};
        for (const std::string& other : others) putList(other, kSkeletonDat, kSkeletonArt);
        index.insert(index.end(), others.begin(), others.end());
        folder.put("pemla.dat", crlf(index));
    }
    void startWithRock() {
        putRock();
        start();
        open("Rock");
    }
    // Puts Rock's files back as they were and opens it again (another list first, so the
    // selection changes).
    void reopenRock() {
        putRock({"Jazz"});
        open("Jazz");
        open("Rock");
    }

    // Every file of the folder with its bytes.
    Files snapshot() const {
        Files files;
        for (const auto& item : std::filesystem::directory_iterator(folder.path())) {
            const std::string name = item.path().filename().string();
            if (name != catalogue::kLockName) files[name] = folder.get(name);
        }
        return files;
    }
    // A list's entry, article and counter files, byte for byte.
    void expectList(const std::string& list, const std::string& dat, const std::string& art,
                    const std::string& arn) const {
        EXPECT_EQ(folder.get(list + ".dat"), dat) << list;
        EXPECT_EQ(folder.get(list + ".art"), art) << list;
        EXPECT_EQ(folder.get(list + ".arn"), arn) << list;
    }

    // The user clears a field and types into it.
    template <typename Box>
    static void retype(Box& box, const std::string& text) {
        box.type(std::string(box.text().size(), '\b') + text);
    }
    void fill(const Item& e) {
        retype(view.Text1, e.title);
        retype(view.Combo1, e.type);
        retype(view.Combo2, e.discs);
        retype(view.Combo3, e.info);
    }
    void select(const std::string& title) {
        ASSERT_TRUE(view.List1.userSelect(title)) << "no title " << title;
    }

    Strings titles() const { return view.List1.items(); }
    std::string fields() const {
        return view.Text1.text() + "|" + view.Combo1.text() + "|" + view.Combo2.text() + "|" +
               view.Combo3.text() + "|" + view.Textart.text();
    }
    void expectReset() const {
        EXPECT_EQ(fields(), "|Select type|Disc(s)|Info|");
        EXPECT_EQ(view.List1.selectedIndex(), -1);
    }
    // Exactly one message box was shown since `before` boxes, with this style, title and prompt
    // (any prompt when none is given).
    void expectBox(std::size_t before, int style, const std::string& title,
                   const std::string& prompt = {}) const {
        const auto& shown = platform.shown();
        ASSERT_EQ(shown.size(), before + 1);
        EXPECT_EQ(shown.back().style, style);
        EXPECT_EQ(shown.back().title, title);
        if (!prompt.empty()) {
            EXPECT_EQ(shown.back().prompt, prompt);
        }
    }
};

}  // namespace main_window_test
