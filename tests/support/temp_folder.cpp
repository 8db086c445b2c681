#include "tests/support/temp_folder.h"

#include <gtest/gtest.h>
#include <stdlib.h>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <vector>

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

std::string TempFolder::listing() const {
    std::vector<std::string> names;
    for (const auto& item : std::filesystem::directory_iterator(path_)) {
        names.push_back(item.path().filename().string());
    }
    std::sort(names.begin(), names.end());
    std::string out;
    for (const auto& name : names) out += name + "\n";
    return out;
}

void putMusicCatalogue(const TempFolder& folder) {
    folder.put("type.dat", "Types\r\nMusic CD\r\nGame\r\n");
    folder.put("information.dat", "Information\r\nOriginal\r\n");
    folder.put("pemla.dat", "Music\r\n");
    folder.put("Music.dat", "<|?Zebra\r\n<|'Music CD\r\n<||1\r\n<|*Original\r\n");
    folder.put("Music.art", "Zebra#*\\Z001\r\n");
    folder.put("Music.arn", "A#001\r\nZ#002\r\n");
    folder.put("Music.inf", " 1 \r\n");
}

}  // namespace test_support
