#include "tests/support/temp_folder.h"

#include <gtest/gtest.h>
#include <stdlib.h>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <set>
#include <sstream>
#include <vector>

#include "catalogue/folder_lock.h"
#include "catalogue/store.h"

namespace test_support {

TempFolder::TempFolder() {
    std::string pattern = (std::filesystem::temp_directory_path() / "pemla-test-XXXXXX").string();
    if (::mkdtemp(pattern.data()) == nullptr) throw std::runtime_error("mkdtemp failed");
    path_ = pattern;
}

TempFolder::~TempFolder() {
    std::error_code ec;
    std::filesystem::permissions(path_, std::filesystem::perms::owner_all,
                                 std::filesystem::perm_options::add, ec);
    std::filesystem::remove_all(path_, ec);
}

void TempFolder::put(std::string_view name, std::string_view bytes) const {
    std::ofstream out(file(name), std::ios::binary | std::ios::trunc);
    out.write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
    if (!out) throw std::runtime_error("cannot write test file " + std::string(name));
}

void TempFolder::putList(const std::string& name, const std::string& entries,
                         const std::string& articles, const std::string& counter,
                         const std::string& flag) const {
    put(name + ".dat", entries);
    put(name + ".art", articles);
    put(name + ".arn", counter);
    if (!flag.empty()) put(name + ".inf", flag);
}

std::string TempFolder::get(std::string_view name) const {
    std::ifstream in(file(name), std::ios::binary);
    if (!in) {
        ADD_FAILURE() << "cannot read " << name;
        return {};
    }
    std::ostringstream bytes;
    bytes << in.rdbuf();
    return bytes.str();
}

bool TempFolder::has(std::string_view name) const {
    std::error_code ec;
    return std::filesystem::exists(std::filesystem::symlink_status(file(name), ec));
}

void TempFolder::remove(std::string_view name) const {
    std::filesystem::remove(file(name));
}

std::string TempFolder::listing() const {
    std::set<std::string> names;
    for (const auto& item : std::filesystem::directory_iterator(path_)) {
        names.insert(item.path().filename().string());
    }
    std::string out;
    for (const auto& name : names) out += name + "\n";
    return out;
}

void putMusicCatalogue(const TempFolder& folder) {
    folder.put("type.dat", "Types\r\nMusic CD\r\nGame\r\n");
    folder.put("information.dat", "Information\r\nOriginal\r\n");
    folder.put("pemla.dat", "Music\r\n");
    folder.putList("Music", "<|?Zebra\r\n<|'Music CD\r\n<||1\r\n<|*Original\r\n",
                   "Zebra#*\\Z001\r\n", "A#001\r\nZ#002\r\n");
}

const std::vector<catalogue::Entry> kRock = {{"Zebra", "CD", "1", "Original"},
                                             {"abcd", "DVD", "2", "Copy"},
                                             {"abc", "Game", "3", ""},
                                             {"xabc", "CD", "10", "x"},
                                             {"1st", "LP", "1", "Original"}};
const std::vector<std::pair<std::string, std::string>> kRockArticles = {
    {"xabc", "X001"}, {"abcd", "A001"}, {"Zebra", "Z001"}, {"1st", "!001"}, {"abc", "A002"}};
const std::vector<std::string> kRockCounter = {"A#003", "Z#002", "X#002", "!#002"};

void putRock(const TempFolder& folder, const std::vector<std::string>& others) {
    folder.putList("Rock", entryText(kRock), articleText(kRockArticles), crlf(kRockCounter));
    std::vector<std::string> index = {"Rock"};
    for (const std::string& other : others) {
        folder.putList(other, std::string(catalogue::kSkeletonEntries),
                       std::string(catalogue::kSkeletonArticles));
        index.push_back(other);
    }
    folder.put("pemla.dat", crlf(index));
}

namespace fs = std::filesystem;

Files snapshot(const std::string& folder, const std::string& prefix) {
    Files files;
    for (const auto& item : fs::directory_iterator(folder)) {
        if (item.path().filename() == catalogue::kLockName) continue;
        std::string& bytes = files[prefix + item.path().filename().string()];
        const fs::file_status status = item.symlink_status();
        if (fs::is_symlink(status)) {
            bytes = "[link to " + fs::read_symlink(item.path()).string() + "]";
        } else if (fs::is_directory(status)) {
            bytes = "[folder]";
        } else if (fs::is_fifo(status)) {
            bytes = "[fifo]";
        } else {
            std::ostringstream in;
            in << std::ifstream(item.path(), std::ios::binary).rdbuf();
            bytes = in.str();
        }
    }
    return files;
}

std::string difference(const Files& a, const Files& b) {
    std::string out;
    for (const auto& [name, bytes] : a) {
        if (!b.contains(name) || b.at(name) != bytes) out += " " + name;
    }
    for (const auto& item : b) out += a.contains(item.first) ? "" : " +" + item.first;
    return out;
}

bool hasLeftovers(const Files& files) {
    return std::any_of(files.begin(), files.end(), [](const auto& item) {
        return item.first.ends_with(catalogue::kTempSuffix) ||
               item.first == catalogue::kJournalName;
    });
}

std::string crlf(const std::vector<std::string>& lines) {
    std::string text;
    for (const std::string& line : lines) text += line + "\r\n";
    return text;
}

std::string entryText(const std::vector<catalogue::Entry>& entries) {
    std::string text;
    for (const catalogue::Entry& e : entries)
        text += crlf({"<|?" + e.title, "<|'" + e.type, "<||" + e.discs, "<|*" + e.information});
    return text;
}

std::string articleText(const std::vector<std::pair<std::string, std::string>>& lines) {
    std::string text;
    for (const auto& [title, number] : lines) text += title + "#*\\" + number + "\r\n";
    return text;
}

}  // namespace test_support
