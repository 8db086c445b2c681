#pragma once

#include <gtest/gtest.h>
#include <sys/stat.h>

#include <filesystem>
#include <map>
#include <string>
#include <vector>

#include "tests/support/memory_form1.h"

// The main window's tests: a catalogue folder with the list "Rock", literal file contents built
// line by line, typing into the entry fields, and snapshots that prove nothing was written.
namespace main_window_test {

using Strings = std::vector<std::string>;
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
    for (const Item& e : items) {
        text += "<|?" + e.title + "\r\n<|'" + e.type + "\r\n<||" + e.discs + "\r\n<|*" + e.info +
                "\r\n";
    }
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

// Every line ends with exactly one CR LF, no line is empty, and no CR or LF stands alone.
inline void expectTidy(const std::string& name, const std::string& bytes) {
    for (std::size_t at = 0, end; at < bytes.size(); at = end + 2) {
        end = bytes.find("\r\n", at);
        ASSERT_TRUE(end != std::string::npos && end > at) << name << ": line at " << at;
        ASSERT_EQ(bytes.substr(at, end - at).find_first_of("\r\n"), std::string::npos)
            << name << ": line at " << at;
    }
}

class Form1Test : public ::testing::Test, public test_support::MainWindowFixture {
  protected:
    using Files = std::map<std::string, std::string>;

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
        for (const std::string& other : others) {
            putList(other, kSkeletonDat, kSkeletonArt);
            index.push_back(other);
        }
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
            files[name] = folder.get(name);
        }
        return files;
    }
    // The file's identity: a file replaced by a new one gets another inode.
    ino_t inode(const std::string& name) const {
        struct stat st {};
        EXPECT_EQ(::stat(folder.file(name).c_str(), &st), 0) << name;
        return st.st_ino;
    }
    void expectFile(const std::string& name, const std::string& expected) const {
        const std::string got = folder.get(name);
        EXPECT_EQ(got, expected) << name;
        expectTidy(name, got);
    }

    // The user clears a field and types into it.
    static void retype(ui::memory::MemoryTextBox& box, const std::string& text) {
        box.type(std::string(box.text().size(), '\b') + text);
    }
    static void retype(ui::memory::MemoryComboBox& box, const std::string& text) {
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
    // Exactly one message box was shown since `before` boxes, with this style and title.
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
