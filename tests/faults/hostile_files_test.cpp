// Damaged and hostile files in the catalogue folder: each is either data the program keeps byte
// for byte, or a file it names in an "Error" box and then leaves alone. Nothing crashes, hangs or
// is written back with less than it held.
#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include <chrono>
#include <filesystem>

#include "catalogue/file_text.h"
#include "catalogue/journal.h"
#include "tests/faults/fault_rig.h"

namespace faults {
namespace {

using ui::Answer;

const std::string kRockDat = entryText({{"Abba Gold", "Music CD", "1", "Original"}});
const std::string kRockArt = crlf({"Abba Gold#*\\A001"});
const std::string kRockArn = crlf({"A#002"});
// What the user adds: typed accented letters are stored as the same single bytes.
const std::string kAddedInfo = "x\xe9\xff";
const std::string kAdded = entryText({{"Dylan", "Game", "1", kAddedInfo}});

std::string allHighBytes() {
    std::string bytes;
    for (int c = 0x80; c <= 0xFF; ++c) bytes.push_back(static_cast<char>(c));
    return bytes;
}

// A file is put with these bytes, or made a folder or a link to nowhere, or removed.
enum class Put { Bytes, Folder, DanglingLink, Missing };

struct Damage {
    const char* name;
    const char* file;
    Put put;
    std::string bytes;
    // Empty: the damage is data the program keeps. Otherwise the file the error box names.
    const char* refused;
};

void PrintTo(const Damage& d, std::ostream* out) {
    *out << d.name;
}

const Damage kDamages[] = {
    {"NulBytes", "Rock.dat", Put::Bytes,
     entryText({{std::string("Nul\0Title", 9), std::string("\0", 1), "1", "a\0b"}}), ""},
    {"HighBytes", "Rock.dat", Put::Bytes,
     entryText({{"\xc9t\xe9 " + allHighBytes().substr(0, 20), allHighBytes(), "1", "\xff"}}), ""},
    {"AMegabyteLine", "Rock.dat", Put::Bytes,
     entryText({{"Big", "CD", "1", std::string(1 << 20, 'x')}}), ""},
    {"ALoneLfInsideALine", "Rock.dat", Put::Bytes, entryText({{"Lone\nLF", "CD", "1", "x"}}), ""},
    {"ATruncatedLastLine", "Rock.dat", Put::Bytes, kRockDat.substr(0, kRockDat.size() - 2), ""},
    {"AnEmptyEntryFile", "Rock.dat", Put::Bytes, "", ""},
    {"AnEmptyCounterFile", "Rock.arn", Put::Bytes, "", ""},
    {"CounterDigitsOverflowing", "Rock.arn", Put::Bytes, "D#99999999999999999999\r\n", ""},
    {"ALoneCrSplittingALine", "Rock.dat", Put::Bytes, entryText({{"Lone\rCR", "CD", "1", "x"}}),
     "Rock.dat"},
    {"SixLinesInTheEntryFile", "Rock.dat", Put::Bytes, kRockDat + "<|?Half\r\n<|'CD\r\n",
     "Rock.dat"},
    {"CounterWithLetters", "Rock.arn", Put::Bytes, "A#002\r\nD#0x1\r\n", "Rock.arn"},
    {"AMissingEntryFile", "Rock.dat", Put::Missing, "", "Rock.dat"},
    {"AFolderForTheEntryFile", "Rock.dat", Put::Folder, "", "Rock.dat"},
    {"AFolderForTheCounterFile", "Rock.arn", Put::Folder, "", "Rock.arn"},
    {"AFolderForTheFlagFile", "Rock.inf", Put::Folder, "", "Rock.inf"},
    {"ADanglingLinkForTheEntryFile", "Rock.dat", Put::DanglingLink, "", "Rock.dat"},
    {"ADanglingLinkForTheArticleFile", "Rock.art", Put::DanglingLink, "", "Rock.art"},
};

void damage(const Rig& r, const Damage& d) {
    const std::string path = r.folder + "/" + d.file;
    std::filesystem::remove(path);
    switch (d.put) {
        case Put::Bytes:
            r.put(d.file, d.bytes);
            break;
        case Put::Folder:
            std::filesystem::create_directory(path);
            break;
        case Put::DanglingLink:
            std::filesystem::create_symlink("no-such-file", path);
            break;
        case Put::Missing:
            break;
    }
}

class DamagedList : public ::testing::TestWithParam<Damage> {};

// The user opens the list and adds "Dylan".
TEST_P(DamagedList, IsKeptByteForByteOrNamedAndLeftAlone) {
    const Damage& d = GetParam();
    Rig r;
    r.putList("Rock", kRockDat, kRockArt, kRockArn);
    r.put("pemla.dat", crlf({"Rock"}));
    damage(r, d);
    const Files before = r.files();
    const auto started = std::chrono::steady_clock::now();
    for (int i = 0; i < 3; ++i) r.platform.answer(Answer::Ok);
    r.start();
    ASSERT_TRUE(r.open("Rock"));
    r.fill("Dylan", "Game", "1", kAddedInfo);
    r.view.Command_add.click();
    const Files after = r.files();
    EXPECT_LT(std::chrono::steady_clock::now() - started, std::chrono::seconds(2));
    if (*d.refused != '\0') {
        ASSERT_FALSE(r.errors().empty());
        EXPECT_TRUE(r.errors().front().prompt.starts_with("The file \"" + std::string(d.refused) +
                                                          "\" could not be used"))
            << r.errors().front().prompt;
        EXPECT_EQ(after, before) << difference(before, after);
        return;
    }
    EXPECT_TRUE(r.errors().empty()) << r.errors().front().prompt;
    // Every line the files held is still there, in front of what was added.
    const auto kept = [&](const char* file) { return catalogue::toFileText(before.at(file)); };
    EXPECT_EQ(after.at("Rock.dat"), kept("Rock.dat") + kAdded);
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

// A commit that could only fail after its point of no return would leave a journal that no start
// can finish: such a target is refused before anything is written.
struct Obstacle {
    const char* name;
    const char* index;  // the list index
    const char* obstacle;
    void (*act)(Rig&);
};

void PrintTo(const Obstacle& o, std::ostream* out) {
    *out << o.name;
}

void deleteRock(Rig& r) {
    r.open("Rock");
    r.platform.answer(Answer::Yes);
    r.platform.answer(Answer::Yes);
    r.platform.answer(Answer::Ok);
    r.view.Command_delete.click();
}

const Obstacle kObstacles[] = {
    {"DeletingAListWhoseFlagFileIsAFolder", "Rock", "Rock.inf",
     [](Rig& r) {
         r.platform.answer(Answer::Ok);  // the list cannot be opened, but it can be deleted
         deleteRock(r);
     }},
    {"DeletingAListWhoseArticleFileIsAFolder", "Rock\r\nJazz", "Rock.art", deleteRock},
    {"CreatingAListWhoseCounterFileIsAFolder", "Rock", "Blues.arn",
     [](Rig& r) {
         r.platform.answer(Answer::Ok);
         r.createList("Blues");
     }},
    {"AddingWhereTheArticleFileIsALinkToAFolder", "Rock", "Rock.art",
     [](Rig& r) {
         r.open("Rock");
         r.platform.answer(Answer::Ok);
         r.fill("Dylan", "Game", "1", "x");
         r.view.Command_add.click();
     }},
};

class Obstacles : public ::testing::TestWithParam<Obstacle> {};

TEST_P(Obstacles, AreRefusedBeforeAnythingChangesAndTheProgramStillStarts) {
    const Obstacle& o = GetParam();
    Rig r;
    r.putList("Rock", kRockDat, kRockArt, kRockArn);
    r.putList("Jazz", kRockDat, kRockArt, kRockArn);
    r.put("pemla.dat", std::string(o.index) + "\r\n");
    const std::string target = r.folder + "/" + o.obstacle;
    std::filesystem::remove(target);
    if (std::string_view(o.name).find("Link") != std::string_view::npos) {
        std::filesystem::create_directory(r.folder + "/elsewhere");
        std::filesystem::create_directory_symlink("elsewhere", target);
    } else {
        std::filesystem::create_directory(target);
    }
    const Files before = r.files();
    r.start();
    o.act(r);
    ASSERT_FALSE(r.errors().empty());
    for (const auto& box : r.errors()) {
        EXPECT_TRUE(box.prompt.starts_with("The file \"" + std::string(o.obstacle))) << box.prompt;
    }
    EXPECT_EQ(r.files(), before) << difference(before, r.files());
    Rig again(r.folder);
    again.start();
    EXPECT_TRUE(again.errors().empty()) << again.errors().front().prompt;
    EXPECT_EQ(r.files(), before) << difference(before, r.files());
}

INSTANTIATE_TEST_SUITE_P(Files, Obstacles, ::testing::ValuesIn(kObstacles),
                         [](const auto& info) { return std::string(info.param.name); });

// Names in a hand-edited index that are no file names of the folder: a NUL byte (the system would
// cut the name there: "pemla.dat\0" would delete the index), a way through another folder back to
// Rock's files, a subfolder, or a name longer than a file name may be.
TEST(HostileIndex, NamesThatAreNoFileNamesAreRefusedAndNoOtherFileIsTouched) {
    Rig r;
    r.putList("Rock", kRockDat, kRockArt, kRockArn);
    std::filesystem::create_directory(r.folder + "/sub");
    r.put("sub/inner.dat", kRockDat);
    const std::string names[] = {
        std::string("pemla.dat\0", 10),
        "../" + std::filesystem::path(r.folder).filename().string() + "/Rock", "sub/inner",
        std::string(1 << 20, 'n')};
    for (const std::string& name : names) {
        SCOPED_TRACE(name.substr(0, 24));
        r.put("pemla.dat", crlf({"Rock", name}));
        const Files before = r.files();
        const std::size_t boxes = r.errors().size();
        const auto started = std::chrono::steady_clock::now();
        r.view.window.unload();
        r.start();
        r.platform.answer(Answer::Ok);
        ASSERT_TRUE(r.open(name));
        r.platform.answer(Answer::Yes);
        r.platform.answer(Answer::Yes);
        r.platform.answer(Answer::Ok);
        r.view.Command_delete.click();
        EXPECT_LT(std::chrono::steady_clock::now() - started, std::chrono::seconds(2));
        const auto errors = r.errors();
        ASSERT_EQ(errors.size(), boxes + 2);
        for (std::size_t i = boxes; i < errors.size(); ++i) {
            EXPECT_TRUE(errors[i].prompt.starts_with("The file \"" + name.substr(0, 9)))
                << errors[i].prompt.substr(0, 80);
        }
        EXPECT_EQ(r.files(), before) << difference(before, r.files());
        EXPECT_EQ(snapshot(r.folder + "/sub"), (Files{{"inner.dat", kRockDat}}));
    }
}

// What an interrupted commit left in the folder, as the next start finds it.
struct Leftover {
    const char* name;
    void (*put)(const Rig&);
    bool replayed;  // the new Rock.dat is in place and Rock.inf gone; otherwise all stays old
};

void PrintTo(const Leftover& l, std::ostream* out) {
    *out << l.name;
}

const std::string kStaged = "Rock.dat.4242-1.pemla-tmp";
const std::string kNewRockDat = entryText({{"Zappa", "CD", "1", "x"}});

std::string journal() {
    catalogue::JournalPlan plan;
    plan.renames.emplace_back(kStaged, "Rock.dat");
    plan.deletions.push_back("Rock.inf");
    return catalogue::encodeJournal(plan);
}

void putJournal(const Rig& r, const std::string& bytes) {
    r.put(kStaged, kNewRockDat);
    r.put(std::string(catalogue::kJournalName), bytes);
}

const Leftover kLeftovers[] = {
    {"ATemporaryFile", [](const Rig& r) { r.put(kStaged, "half a fi"); }, false},
    {"AGarbledJournal",
     [](const Rig& r) {
         std::string bytes = journal();
         bytes[20] ^= 0x20;
         putJournal(r, bytes);
     },
     false},
    {"ATornJournal", [](const Rig& r) { putJournal(r, journal().substr(0, 30)); }, false},
    {"AnEmptyJournal", [](const Rig& r) { putJournal(r, ""); }, false},
    {"ACompleteJournal", [](const Rig& r) { putJournal(r, journal()); }, true},
    {"ACompleteJournalHalfCarriedOut",
     [](const Rig& r) {
         r.put("Rock.dat", kNewRockDat);
         r.put(std::string(catalogue::kJournalName), journal());
     },
     true},
};

class StartUp : public ::testing::TestWithParam<Leftover> {};

TEST_P(StartUp, FinishesACompleteJournalAndDropsEverythingElseItLeft) {
    const Leftover& l = GetParam();
    Rig r;
    r.putList("Rock", kRockDat, kRockArt, kRockArn);
    r.put("pemla.dat", crlf({"Rock"}));
    Files expected = r.files();
    if (l.replayed) {
        expected["Rock.dat"] = kNewRockDat;
        expected.erase("Rock.inf");
    }
    l.put(r);
    r.start();
    EXPECT_TRUE(r.errors().empty()) << r.errors().front().prompt;
    EXPECT_EQ(r.files(), expected) << difference(expected, r.files());
    ASSERT_TRUE(r.open("Rock"));
    EXPECT_EQ(r.view.List1.items(), std::vector<std::string>{l.replayed ? "Zappa" : "Abba Gold"});
}

INSTANTIATE_TEST_SUITE_P(Leftovers, StartUp, ::testing::ValuesIn(kLeftovers),
                         [](const auto& info) { return std::string(info.param.name); });

TEST(StartUpJournal, AJournalThatCannotBeReadIsKeptAndNamed) {
    Rig r;
    r.putList("Rock", kRockDat, kRockArt, kRockArn);
    r.put("pemla.dat", crlf({"Rock"}));
    std::filesystem::create_directory(r.folder + "/" + std::string(catalogue::kJournalName));
    const Files before = r.files();
    r.platform.answer(Answer::Ok);
    r.start();
    ASSERT_EQ(r.errors().size(), 1u);
    EXPECT_TRUE(
        r.errors().front().prompt.starts_with("Pemla cannot start: the file \"pemla.journal\""))
        << r.errors().front().prompt;
    EXPECT_TRUE(r.platform.ended());
    EXPECT_EQ(r.files(), before);
}

}  // namespace
}  // namespace faults
