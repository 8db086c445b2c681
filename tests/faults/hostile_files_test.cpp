// Damaged and hostile files in the catalogue folder: each is either data the program keeps byte
// for byte, or a file it names in an "Error" box and then leaves alone. Nothing crashes, hangs or
// is written back with less than it held.
#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include <chrono>
#include <filesystem>

#include "catalogue/file_text.h"
#include "tests/faults/fault_rig.h"

namespace faults {
namespace {

namespace fs = std::filesystem;
using ui::Answer;

// What the user adds: typed accented letters are stored as the same single bytes.
const std::string kAddedInfo = "x\xe9\xff";

std::string highBytes(int count) {
    std::string bytes;
    for (int c = 0x80; c < 0x80 + count; ++c) bytes.push_back(static_cast<char>(c));
    return bytes;
}

struct Damage {
    const char* name;
    const char* file;
    // Its bytes, or as a snapshot shows them "[folder]" or "[link to X]"; or "[missing]", or
    // "[protected]": as put, with every write permission bit cleared (refused even as root).
    std::string bytes;
    // The file is named in an error box and nothing changes; otherwise it is data to keep.
    bool refused;
    // What the user does; by default opens "Rock" and adds "Dylan".
    void (*act)(Rig&) = nullptr;
    std::vector<std::string> otherLists = {};
};

void PrintTo(const Damage& d, std::ostream* out) {
    *out << d.name;
}

// A commit that could only fail after its point of no return would leave a journal that no start
// can finish: such a target is refused before anything is written.
void deleteRock(Rig& r) {
    r.open("Rock");
    r.deleteList();
}

const Damage kDamages[] = {
    {"NulBytes", "Rock.dat",
     entryText({{std::string("Nul\0Title", 9), std::string("\0", 1), "1", "a\0b"}}), false},
    {"HighBytes", "Rock.dat",
     entryText({{"\xc9t\xe9 " + highBytes(20), highBytes(128), "1", "\xff"}}), false},
    {"AMegabyteLine", "Rock.dat", entryText({{"Big", "CD", "1", std::string(1 << 20, 'x')}}),
     false},
    {"ALoneLfInsideALine", "Rock.dat", entryText({{"Lone\nLF", "CD", "1", "x"}}), false},
    {"ATruncatedLastLine", "Rock.dat", kAbbaDat.substr(0, kAbbaDat.size() - 2), false},
    {"AnEmptyEntryFile", "Rock.dat", "", false},
    {"CounterDigitsOverflowing", "Rock.arn", "D#99999999999999999999\r\n", false},
    {"ALoneCrSplittingALine", "Rock.dat", entryText({{"Lone\rCR", "CD", "1", "x"}}), true},
    {"SixLinesInTheEntryFile", "Rock.dat", kAbbaDat + "<|?Half\r\n<|'CD\r\n", true},
    {"CounterWithLetters", "Rock.arn", "A#002\r\nD#0x1\r\n", true},
    {"AMissingEntryFile", "Rock.dat", "[missing]", true},
    {"AFolderForTheEntryFile", "Rock.dat", "[folder]", true},
    {"AFolderForTheCounterFile", "Rock.arn", "[folder]", true},
    {"AFolderForTheFlagFile", "Rock.inf", "[folder]", true},
    {"AFifoForTheEntryFile", "Rock.dat", "[fifo]", true},
    {"AFifoForTheCounterFile", "Rock.arn", "[fifo]", true},
    // The dialog opens on its defaults; the closing's save names the file and leaves it.
    {"AFifoForTheExportSettings", "export.dat", "[fifo]", true,
     [](Rig& r) {
         r.open("Rock");
         r.press(r.view.Command_export, {Answer::Ok});
         r.exportView.window.userClose();
     }},
    {"ADanglingLinkForTheArticleFile", "Rock.art", "[link to no-such-file]", true},
    {"AddingWhereTheArticleFileIsALinkToAFolder", "Rock.art", "[link to elsewhere]", true},
    {"DeletingAListWhoseArticleFileIsAFolder", "Rock.art", "[folder]", true, deleteRock, {"Jazz"}},
    {"AProtectedArticleFile", "Rock.art", "[protected]", true},
    {"DeletingAListWithAProtectedFile", "Rock.art", "[protected]", true, deleteRock, {"Jazz"}},
    {"CreatingAListWhoseCounterFileIsAFolder", "Blues.arn", "[folder]", true,
     [](Rig& r) {
         r.platform.answer(Answer::Ok);
         r.createList("Blues");
     }},
};

class DamagedList : public ::testing::TestWithParam<Damage> {};

TEST_P(DamagedList, IsKeptByteForByteOrNamedAndLeftAlone) {
    const Damage& d = GetParam();
    Rig r;
    putRock(r.folder, d.otherLists);
    const std::string path = r.folder.path() + "/" + d.file;
    if (d.bytes != "[protected]") fs::remove(path);
    fs::create_directory(r.folder.path() + "/elsewhere");
    if (d.bytes == "[folder]") {
        fs::create_directory(path);
    } else if (d.bytes == "[fifo]") {
        ASSERT_EQ(::mkfifo(path.c_str(), 0644), 0);
    } else if (d.bytes.starts_with("[link to ")) {
        fs::create_symlink(d.bytes.substr(9, d.bytes.size() - 10), path);
    } else if (d.bytes == "[protected]") {
        ASSERT_EQ(::chmod(path.c_str(), 0444), 0);
    } else if (d.bytes != "[missing]") {
        r.folder.put(d.file, d.bytes);
    }
    const Files before = r.files();
    const auto started = std::chrono::steady_clock::now();
    ::alarm(20);  // a read that waits on a FIFO ends the test run instead of hanging it
    r.start();
    if (d.act != nullptr) {
        d.act(r);
    } else {
        r.platform.answer(Answer::Ok);
        ASSERT_TRUE(r.open("Rock"));
        r.addDylan(kAddedInfo);
    }
    ::alarm(0);
    EXPECT_LT(std::chrono::steady_clock::now() - started, std::chrono::seconds(2));
    const Files after = r.files();
    if (d.refused) {
        // The file is named first; what the user tries next on that list is refused as well.
        const std::string named = "The file \"" + std::string(d.file) + "\" could not be used";
        ASSERT_FALSE(r.errors().empty());
        EXPECT_TRUE(r.errors().front().prompt.starts_with(named)) << r.errors().front().prompt;
        for (const auto& box : r.errors()) {
            EXPECT_TRUE(box.prompt.starts_with(named) ||
                        box.prompt.starts_with("The list \"Rock\" could not be read whole"))
                << box.prompt;
        }
        // The files as they were, temporary files and the journal included: nothing is left for
        // the next start to finish or trip over.
        EXPECT_EQ(after, before) << difference(before, after);
        return;
    }
    EXPECT_TRUE(r.errors().empty()) << r.errors().front().prompt;
    // Every line the files held is still there, in front of what was added.
    const auto kept = [&](const char* file) { return catalogue::toFileText(before.at(file)); };
    EXPECT_EQ(after.at("Rock.dat"),
              kept("Rock.dat") + entryText({{"Dylan", "Game", "1", kAddedInfo}}));
    const std::string& art = after.at("Rock.art");
    EXPECT_TRUE(art.starts_with(kept("Rock.art") + "Dylan#*\\D")) << art;
    if (std::string_view(d.name) == "CounterDigitsOverflowing") {
        // The record's first three digits count: D999 is handed out and D is used up; the
        // surplus digits stay as they were.
        EXPECT_TRUE(art.ends_with("Dylan#*\\D999\r\n"));
        EXPECT_EQ(after.at("Rock.arn"), "D#00099999999999999999\r\n");
    }
}

INSTANTIATE_TEST_SUITE_P(Files, DamagedList, ::testing::ValuesIn(kDamages),
                         [](const auto& info) { return std::string(info.param.name); });

// Names in a hand-edited index that are no file names of the folder: a NUL byte (the system would
// cut the name there: "pemla.dat\0" would delete the index), a way through another folder back to
// Rock's files, a subfolder, or a name longer than a file name may be.
TEST(HostileIndex, NamesThatAreNoFileNamesAreRefusedAndNoOtherFileIsTouched) {
    Rig r;
    putRock(r.folder);
    fs::create_directory(r.folder.path() + "/sub");
    r.folder.put("sub/inner.dat", kAbbaDat);
    r.folder.put("sub/inn\xE9r.dat", kAbbaDat);  // a name an earlier build would have used
    const std::string names[] = {std::string("pemla.dat\0", 10),
                                 "../" + fs::path(r.folder.path()).filename().string() + "/Rock",
                                 "sub/inner", "sub/inn\xE9r", std::string(1 << 20, 'n')};
    for (const std::string& name : names) {
        SCOPED_TRACE(name.substr(0, 24));
        r.folder.put("pemla.dat", crlf({"Rock", name}));
        const Files before = r.files();
        const std::size_t boxes = r.errors().size();
        const auto started = std::chrono::steady_clock::now();
        r.view.window.unload();
        r.start();
        r.platform.answer(Answer::Ok);
        ASSERT_TRUE(r.open(name));
        r.deleteList();
        EXPECT_LT(std::chrono::steady_clock::now() - started, std::chrono::seconds(2));
        const auto errors = r.errors();
        ASSERT_EQ(errors.size(), boxes + 2);
        for (std::size_t i = boxes; i < errors.size(); ++i) {
            EXPECT_TRUE(errors[i].prompt.starts_with("The file \"" + name.substr(0, 9)))
                << errors[i].prompt.substr(0, 80);
        }
        EXPECT_EQ(r.files(), before) << difference(before, r.files());
        EXPECT_EQ(snapshot(r.folder.path() + "/sub"),
                  (Files{{"inner.dat", kAbbaDat}, {"inn\xE9r.dat", kAbbaDat}}));
    }
}

}  // namespace
}  // namespace faults
