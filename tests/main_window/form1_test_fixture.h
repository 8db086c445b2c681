#pragma once

#include <gtest/gtest.h>

#include <filesystem>
#include <string>
#include <vector>

#include "tests/support/memory_form1.h"

// The main window's tests: a catalogue folder with the list "Rock", the entry fields as the
// user sees them, and the message boxes shown.
namespace main_window_test {

using Strings = std::vector<std::string>;
using test_support::articleText;
using test_support::crlf;
using test_support::entryText;
using test_support::Files;
using ui::Answer;

// The names the command tests build their files with.
using Item = catalogue::Entry;
struct Art {
    std::string title, number;
};
inline std::string entries(const std::vector<Item>& items) {
    return entryText(items);
}
inline std::string articles(const std::vector<Art>& lines) {
    std::string text;
    for (const Art& a : lines) text += articleText({{a.title, a.number}});
    return text;
}

class Form1Test : public ::testing::Test, public test_support::MainWindowFixture {
  protected:
    // "Rock" in the order its entries were added; List1 shows 1st, abc, abcd, xabc, Zebra.
    // "abcd" stands before "abc" and "xabc" ends with "abc", in both files.
    const std::vector<catalogue::Entry> rock = {{"Zebra", "CD", "1", "Original"},
                                                {"abcd", "DVD", "2", "Copy"},
                                                {"abc", "Game", "3", ""},
                                                {"xabc", "CD", "10", "x"},
                                                {"1st", "LP", "1", "Original"}};

    // Puts "Rock" (and the given other lists, as placeholder lists) into the folder and index.
    void putRock(const Strings& others = {}) {
        putList("Rock", entryText(rock),
                articleText({{"xabc", "X001"},
                             {"abcd", "A001"},
                             {"Zebra", "Z001"},
                             {"1st", "!001"},
                             {"abc", "A002"}}),
                crlf({"A#003", "Z#002", "X#002", "!#002"}));
        Strings index = {"Rock"};
        for (const std::string& other : others) {
            putList(other, std::string(catalogue::kSkeletonEntries),
                    std::string(catalogue::kSkeletonArticles));
            index.push_back(other);
        }
        folder.put("pemla.dat", crlf(index));
    }
    void startWithRock(const Strings& others = {}) {
        putRock(others);
        start();
        open("Rock");
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
};

}  // namespace main_window_test
