#pragma once

#include <map>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "catalogue/records.h"

namespace test_support {

// A fresh empty folder for one test, removed with everything in it afterwards.
class TempFolder {
  public:
    TempFolder();
    ~TempFolder();
    TempFolder(const TempFolder&) = delete;
    TempFolder& operator=(const TempFolder&) = delete;

    const std::string& path() const { return path_; }
    std::string file(std::string_view name) const { return path_ + "/" + std::string(name); }
    // Writes bytes to a file of the folder directly (test set-up, not the program's path).
    void put(std::string_view name, std::string_view bytes) const;
    // Writes a list's files: entry text, article text, counter text, and the flag (none when
    // `flag` is empty).
    void putList(const std::string& name, const std::string& entries, const std::string& articles,
                 const std::string& counter = "A#001\r\n",
                 const std::string& flag = " 1 \r\n") const;
    // The bytes of a file of the folder; fails the test when it cannot be read.
    std::string get(std::string_view name) const;
    bool has(std::string_view name) const;
    void remove(std::string_view name) const;
    // Every file name in the folder, sorted.
    std::string listing() const;

  private:
    std::string path_;
};

// A small catalogue for the tests of the real windows: the suggestion files and the list "Music"
// holding "Zebra" (Music CD, 1 disc, Original, Z001).
void putMusicCatalogue(const TempFolder& folder);

// "Rock" in the order its entries were added, its article lines and its counter: "abcd" stands
// before "abc" and "xabc" ends with "abc", in both files; a window shows 1st, abc, abcd, xabc,
// Zebra.
extern const std::vector<catalogue::Entry> kRock;
extern const std::vector<std::pair<std::string, std::string>> kRockArticles;
extern const std::vector<std::string> kRockCounter;
// Puts "Rock", and the given other lists as placeholder lists, into the folder and the index.
void putRock(const TempFolder& folder, const std::vector<std::string>& others = {});

// Every file of a folder by name: its bytes, or "[folder]", "[fifo]", "[link to X]". The running
// program's lock file is left out; temporary files and the journal are in.
using Files = std::map<std::string, std::string>;
Files snapshot(const std::string& folder, const std::string& prefix = {});
// The names that differ between two snapshots (" +name": only in the second), for a message.
std::string difference(const Files& a, const Files& b);
// Whether a temporary file or a journal is among the files.
bool hasLeftovers(const Files& files);

// Lines, each followed by CR LF: what every file the program writes looks like.
std::string crlf(const std::vector<std::string>& lines);
// Entries as the entry file holds them, four tagged lines each.
std::string entryText(const std::vector<catalogue::Entry>& entries);
// Article lines from title and number.
std::string articleText(const std::vector<std::pair<std::string, std::string>>& lines);

}  // namespace test_support
