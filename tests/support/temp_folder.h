#pragma once

#include <string>
#include <string_view>

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
    // The bytes of a file of the folder; fails the test when it cannot be read.
    std::string get(std::string_view name) const;
    bool has(std::string_view name) const;
    // Every file name in the folder, sorted.
    std::string listing() const;

  private:
    std::string path_;
};

// A small catalogue for the tests of the real windows: the suggestion files and the list "Music"
// holding "Zebra" (Music CD, 1 disc, Original, Z001).
void putMusicCatalogue(const TempFolder& folder);

}  // namespace test_support
