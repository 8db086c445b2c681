// export and import from the command line, on files in a temporary data folder.
#include "app/command_tasks.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <sstream>
#include <tuple>

#include "app/command_line.h"
#include "bench/catalogue_maker.h"
#include "catalogue/entry_rules.h"
#include "catalogue/folder_lock.h"
#include "catalogue/records.h"
#include "tests/export/export_fixture.h"

namespace {

struct Outcome {
    int status;
    std::string out, err;
};

// `pemla ARGS` on the catalogue in `folder`, as main() runs a command once the folder is open.
Outcome run(const std::string& folder, std::vector<std::string> args) {
    args.insert(args.begin(), "pemla");
    std::vector<const char*> argv;
    for (const std::string& arg : args) argv.push_back(arg.c_str());
    const app::CommandLine line = app::parseCommandLine(static_cast<int>(argv.size()), argv.data());
    std::ostringstream out, err;
    const bool exports = line.action == app::CommandLine::Action::Export;
    EXPECT_TRUE(exports || line.action == app::CommandLine::Action::Import) << line.output;
    const int status = exports ? app::exportCommand(line, folder, out, err)
                               : app::importCommand(line, folder, out, err);
    return {status, out.str(), err.str()};
}

// Entries with their article numbers: the entry file and the article file they make.
using Rows = std::vector<std::pair<catalogue::Entry, std::string>>;
std::string entries(const Rows& rows) {
    std::string text;
    for (const auto& [entry, number] : rows) text += catalogue::entryLines(entry);
    return text;
}
std::string articles(const Rows& rows) {
    std::string text;
    for (const auto& [entry, number] : rows) text += catalogue::articleLine(entry.title, number);
    return text;
}

// "Rock" holds "Abba Gold"; its letter Q has handed out every number.
class Commands : public ::testing::Test {
  protected:
    void SetUp() override {
        folder.put("pemla.dat", "Rock\r\n");
        folder.putList("Rock", entries(kRock), articles(kRock), kRockArn);
    }
    Outcome import(const std::string& list, const std::string& csv) {
        folder.put("in.csv", csv);
        return run(folder.path(), {"import", list, folder.file("in.csv")});
    }

    const Rows kRock = {{{"Abba Gold", "Music CD", "1", "Original"}, "A001"}};
    const std::string kRockArn = "A#002\r\nQ#000\r\n";
    test_support::TempFolder folder;
};

TEST_F(Commands, ImportAddsEachRowAsAddWouldOrSaysWhyNot) {
    const std::string marks =
        "cannot hold a line break: the list's files use it to mark their records.";
    const struct {
        std::string csv;
        int status;
        Rows added;
        std::string counter;               // after "A#002", "Q#000"
        std::vector<std::string> refused;  // "line: reason"
    } cases[] = {
        // A byte order mark, columns by name in any case, LF line ends, a field of 17 bytes.
        {"\xEF\xBB\xBFTITLE,Extra,Discs\nZoot suit riot 17,x,3\nBass,y,<||\n\n",
         3,
         {{{"Zoot suit riot 17", "", "3", ""}, "Z001"}},
         "Z#002\r\n",
         {"3: The number of discs cannot hold \"<||\": the list's files use it to mark their "
          "records."}},
        // Latin-1, and titles alike but for the case of accented letters, short and past the
        // sixteenth byte.
        {"title\r\nCaf\xE9\r\n\xC9t\xE9\r\n\xE9T\xC9\r\nLive at the Caf\xE9 Royal\r\n"
         "LIVE AT THE CAF\xC9 ROYAL\r\n",
         3,
         {{{"Caf\xE9", "", "", ""}, "C001"},
          {{"\xC9t\xE9", "", "", ""}, "!001"},
          {{"Live at the Caf\xE9 Royal", "", "", ""}, "L001"}},
         "C#002\r\n!#002\r\nL#002\r\n",
         {"4: " + std::string(catalogue::kDuplicateTitle),
          "6: " + std::string(catalogue::kDuplicateTitle)}},
        {"title,type\r\nabba "
         "gold,x\r\n\"two\r\nlines\",y\r\nbad<|?,z\r\n\xE2\x82\xAC,u\r\n,empty\r\n"
         "New,ok\r\nNEW,dup\r\nQueen,q\r\n\"open,\r\n",
         3,
         {{{"New", "ok", "", ""}, "N001"}},
         "N#002\r\n",
         {"2: " + std::string(catalogue::kDuplicateTitle), "3: The title " + marks,
          "5: The title cannot hold \"<|?\": the list's files use it to mark their records.",
          "6: The title holds the character U+20AC, which the list's files cannot store (they "
          "hold Latin-1 only).",
          "7: Please type a title first.", "9: " + std::string(catalogue::kDuplicateTitle),
          "10: Every article number of the letter Q (Q001 to Q999) has been handed out in this "
          "list, so no other title that files under this letter can be stored in it.",
          "11: A quoted field is not closed before the file ends."}},
        // Only refused rows: nothing written.
        {"title\r\nAbba Gold\r\n", 1, {}, "", {"2: " + std::string(catalogue::kDuplicateTitle)}},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.csv);
        SetUp();
        const Outcome r = import("rock", c.csv);
        EXPECT_EQ(r.status, c.status);
        Rows rock = kRock;
        rock.insert(rock.end(), c.added.begin(), c.added.end());
        EXPECT_EQ(folder.get("Rock.dat") + folder.get("Rock.art") + folder.get("Rock.arn"),
                  entries(rock) + articles(rock) + kRockArn + c.counter);
        std::string err;
        for (const std::string& refused : c.refused) {
            err += "pemla: " + folder.file("in.csv") + " line " + refused + "\n";
        }
        EXPECT_EQ(r.err, err);
        EXPECT_EQ(r.out, std::to_string(c.added.size()) + (c.added.size() == 1 ? " row" : " rows") +
                             " added to the list \"Rock\", " + std::to_string(c.refused.size()) +
                             " refused.\n");
    }
    EXPECT_EQ(folder.listing(),
              "Rock.arn\nRock.art\nRock.dat\nRock.inf\nin.csv\npemla.dat\npemla.lock\n");
}

// The files of a new list with the rows of a UTF-8 file are the round trip's below.
TEST_F(Commands, ImportCreatesAMissingListWithExactlyItsRowsOrRefusesTheWholeFile) {
    const struct {
        std::string list, csv, err;
    } refusals[] = {
        {"Blues", "name,type\r\nx,y\r\n", "The header row (line 1) names no \"title\" column."},
        {"Blues", "", "The file holds no header row."},
        {"Blues", "title\r\n,\r\n", ""},  // every row refused: no list is made for none
        {"type", "title\r\nx\r\n",
         "The list \"type\" cannot be created: A list with that name already exist!"},
        {"Sal\xC3\xA9", "title\r\n\xC3\xA9t\xC3\xA9\r\n", ""},  // a UTF-8 name is stored as Latin-1
    };
    for (const auto& c : refusals) {
        const Outcome r = import(c.list, c.csv);
        if (c.err.empty()) continue;
        EXPECT_EQ(std::pair(r.status, r.err), std::pair(1, "pemla: " + c.err + "\n"));
    }
    EXPECT_EQ(folder.get("pemla.dat"), "Rock\r\nSal\xE9\r\n");
    EXPECT_EQ(folder.get(catalogue::articleFile("Sal\xE9")), "\xE9t\xE9#*\\!001\r\n");
    for (const char* list : {"Blues", "type"}) EXPECT_FALSE(folder.has(catalogue::entryFile(list)));
}

TEST_F(Commands, ImportStopsAtTheListsCap) {
    bench::writeList(folder.path(), "Rock", catalogue::kMaxEntries - 1);
    const std::string full = folder.get("Rock.dat");
    const Outcome r = import("Rock", "title\r\nLast\r\nOne more\r\n");
    EXPECT_EQ(r.status, 3);
    EXPECT_EQ(r.err, "pemla: " + folder.file("in.csv") + " line 3: " + catalogue::kListFull + "\n");
    EXPECT_EQ(folder.get("Rock.dat"), full + "<|?Last\r\n<|'\r\n<||\r\n<|*\r\n");
}

// Rock's titles with commas, quotes and accents go out as UTF-8 CSV in the list's order and come
// back in that order into a new list with the information column, with new numbers.
TEST_F(Commands, CsvRoundTrip) {
    const Rows rock = {kRock[0],
                       {{"Zoo, \"live\"", "LP", "2", "x"}, "Z001"},
                       {{"\xE9t\xE9", "CD", "1", " na\xEFve "}, "!001"}};
    folder.put("Rock.dat", entries(rock));
    folder.put("Rock.art", articles(rock));
    const std::string csv =
        "title,type,discs,information,article number\r\n"
        "Abba Gold,Music CD,1,Original,A001\r\n"
        "\"Zoo, \"\"live\"\"\",LP,2,x,Z001\r\n"
        "\xC3\xA9t\xC3\xA9,CD,1,\" na\xC3\xAFve \",!001\r\n";
    Outcome r = run(folder.path(), {"export", "Rock", "--csv"});
    EXPECT_EQ(std::pair(r.status, r.out), std::pair(0, csv)) << r.err;
    r = run(folder.path(), {"export", "--csv", "Rock", "--output", folder.file("rock.csv")});
    EXPECT_EQ(std::pair(r.status, folder.get("rock.csv")), std::pair(0, csv)) << r.err;
    r = run(folder.path(), {"import", "Copy", folder.file("rock.csv")});
    EXPECT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(r.out, "3 rows added to the list \"Copy\" (a new list), 0 refused.\n");
    EXPECT_EQ(folder.get("Copy.dat") + folder.get("Copy.art"), entries(rock) + articles(rock));
    EXPECT_EQ(folder.get("Copy.arn") + folder.get("Copy.inf"),
              "A#002\r\nZ#002\r\n!#002\r\n 1 \r\n");
}

TEST_F(Commands, RefusalsNameWhatFailed) {
    const struct {
        std::vector<std::string> args;
        std::string err;
    } cases[] = {
        {{"export", "Nope"},
         "There is no list \"Nope\" in the data folder \"" + folder.path() + "\"."},
        {{"export", "Rock", "--output", folder.file("no/r.txt")},
         "The file \"" + folder.file("no/r.txt") +
             "\" could not be written: No such file or directory."},
        {{"export", "Rock", "--csv"},
         "The file \"Rock.art\" could not be used: No such file or directory."},
    };
    std::filesystem::remove(folder.file("Rock.art"));
    for (const auto& c : cases) {
        const Outcome r = run(folder.path(), c.args);
        EXPECT_EQ(std::tuple(r.status, r.err, r.out), std::tuple(1, "pemla: " + c.err + "\n", ""));
    }
}

// A folder that a running window holds is not written: no journal finished, no row imported.
// An export there only reads (the dialog comparison below runs beside a window).
TEST_F(Commands, ImportRefusesAFolderARunningCopyHolds) {
    const catalogue::FolderLock window(folder.path());
    ASSERT_EQ(window.state(), catalogue::FolderLock::State::Held);
    folder.put("pemla.journal", "torn");
    folder.put("in.csv", "title\r\nNew\r\n");
    const std::string before = folder.listing();
    const Outcome r = run(folder.path(), {"import", "Rock", folder.file("in.csv")});
    EXPECT_EQ(r.status, 1);
    EXPECT_EQ(r.err, "pemla: Pemla is already running on the data folder \"" + folder.path() +
                         "\": close it first. Nothing was imported.\n");
    EXPECT_EQ(folder.listing(), before);
    EXPECT_EQ(folder.get("Rock.dat"), entries(kRock));
    EXPECT_EQ(folder.get("pemla.journal"), "torn");
}

// The command writes what the dialog writes with the same options: --html and --article-numbers
// decide those two, export.dat the others (here counter, separator lines and the last added).
TEST(CommandExport, WritesWhatTheExportDialogWrites) {
    for (const bool html : {false, true}) {
        // Text without and the page with article numbers.
        export_test::ExportFixture f;
        f.openMovies(" 0 \r\n");
        f.main.folder.put("Movies.top", "Top text\r\n");
        const auto saved = [&](bool on) {
            const char* box = on ? "1" : "0";
            f.main.folder.put("export.dat", test_support::crlf({f.out.path(), box, box, "1", "0",
                                                                "1", "1", "3", "Bottom"}));
        };
        saved(html);
        f.openDialog();
        f.main.platform.answer(ui::Answer::Ok);
        f.dialog.Command1.click();
        const std::string written = f.out.get(html ? "Movies.html" : "Movies.TXT");
        saved(!html);  // the saved boxes say the opposite: the command's options decide
        std::vector<std::string> args = {"export", "movies"};
        if (html) args.insert(args.end(), {"--html", "--article-numbers"});
        const Outcome r = run(f.main.folder.path(), args);
        EXPECT_EQ(r.status, 0) << r.err;
        EXPECT_EQ(r.out, written) << html;
    }
}

}  // namespace
