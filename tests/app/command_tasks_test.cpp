// export and import from the command line, on files in a temporary data folder.
#include "app/command_tasks.h"

#include <gtest/gtest.h>

#include <sstream>

#include "app/command_line.h"
#include "catalogue/entry_rules.h"
#include "catalogue/folder_lock.h"
#include "tests/export/export_fixture.h"
#include "tests/main_window/form1_test_fixture.h"

namespace {

using main_window_test::articles;
using main_window_test::crlf;
using main_window_test::entries;
using main_window_test::Item;

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
    int status = -1;
    if (line.action == app::CommandLine::Action::Export) {
        status = app::exportCommand(line, folder, out, err);
    } else if (line.action == app::CommandLine::Action::Import) {
        status = app::importCommand(line, folder, out, err);
    } else {
        ADD_FAILURE() << "not a command: " << line.output;
    }
    return {status, out.str(), err.str()};
}

// "Rock" holds "Abba Gold"; its letter Q has handed out every number.
class Commands : public ::testing::Test {
  protected:
    void SetUp() override {
        folder.put("pemla.dat", crlf({"Rock"}));
        folder.put("Rock.dat", kRockDat);
        folder.put("Rock.art", kRockArt);
        folder.put("Rock.arn", kRockArn);
        folder.put("Rock.inf", " 1 \r\n");
    }
    Outcome import(const std::string& list, const std::string& csv) {
        folder.put("in.csv", csv);
        return run(folder.path(), {"import", list, folder.file("in.csv")});
    }

    const std::string kRockDat = entries({{"Abba Gold", "Music CD", "1", "Original"}});
    const std::string kRockArt = articles({{"Abba Gold", "A001"}});
    const std::string kRockArn = crlf({"A#002", "Q#000"});
    test_support::TempFolder folder;
};

TEST_F(Commands, ImportAddsEachRowAsAddWouldOrSaysWhyNot) {
    const std::string lineBreak =
        "The title cannot hold a line break: the list's files use it to mark their records.";
    const struct {
        const char* name;
        std::string csv;
        int status;
        std::vector<Item> added;
        std::vector<main_window_test::Art> numbers;
        std::string counter;               // after "A#002", "Q#000"
        std::vector<std::string> refused;  // "line: reason"
    } cases[] = {
        {"QuotedFieldsCrLf",
         "title,type,discs,information\r\n\"Blur, 13\",\"say \"\"hi\"\"\",2,\"a,b\"\r\n",
         0,
         {{"Blur, 13", "say \"hi\"", "2", "a,b"}},
         {{"Blur, 13", "B001"}},
         "B#002\r\n",
         {}},
        {"LfColumnsByNameInAnyCase",
         "Discs,Extra,TITLE\n3,x,Zoot\n\n",
         0,
         {{"Zoot", "", "3", ""}},
         {{"Zoot", "Z001"}},
         "Z#002\r\n",
         {}},
        {"BomAndUtf8",
         "\xEF\xBB\xBFtitle,information\r\nCaf\xC3\xA9,na\xC3\xAFve\r\n",
         0,
         {{"Caf\xE9", "", "", "na\xEFve"}},
         {{"Caf\xE9", "C001"}},
         "C#002\r\n",
         {}},
        {"Latin1",
         "title\r\nCaf\xE9\r\n\xC9t\xE9\r\n",
         0,
         {{"Caf\xE9", "", "", ""}, {"\xC9t\xE9", "", "", ""}},
         {{"Caf\xE9", "C001"}, {"\xC9t\xE9", "!001"}},
         "C#002\r\n!#002\r\n",
         {}},
        {"RefusedRows",
         "title,type\r\nabba "
         "gold,x\r\n\"two\r\nlines\",y\r\nbad<|?,z\r\n\xE2\x82\xAC,u\r\n,empty\r\n"
         "New,ok\r\nNEW,dup\r\nQueen,q\r\n\"open,\r\n",
         3,
         {{"New", "ok", "", ""}},
         {{"New", "N001"}},
         "N#002\r\n",
         {"2: " + std::string(catalogue::kDuplicateTitle), "3: " + lineBreak,
          "5: The title cannot hold \"<|?\": the list's files use it to mark their records.",
          "6: The title holds the character U+20AC, which the list's files cannot store (they "
          "hold Latin-1 only).",
          "7: Please type a title first.", "9: " + std::string(catalogue::kDuplicateTitle),
          "10: Every article number of the letter Q (Q001 to Q999) has been handed out in this "
          "list, so no other title that files under this letter can be stored in it.",
          "11: A quoted field is not closed before the file ends."}},
        {"OnlyRefusedRowsWriteNothing",
         "title\r\nAbba Gold\r\n",
         1,
         {},
         {},
         "",
         {"2: " + std::string(catalogue::kDuplicateTitle)}},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.name);
        SetUp();
        const Outcome r = import("rock", c.csv);
        EXPECT_EQ(r.status, c.status);
        EXPECT_EQ(folder.get("Rock.dat"), kRockDat + entries(c.added));
        EXPECT_EQ(folder.get("Rock.art"), kRockArt + articles(c.numbers));
        EXPECT_EQ(folder.get("Rock.arn"), kRockArn + c.counter);
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

TEST_F(Commands, ImportCreatesAMissingListWithExactlyItsRowsOrRefusesTheWholeFile) {
    Outcome r = import("Jazz", "title,discs\r\nMiles,2\r\nBird,1\r\n");
    EXPECT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(r.out, "2 rows added to the list \"Jazz\" (a new list), 0 refused.\n");
    EXPECT_EQ(folder.get("pemla.dat"), crlf({"Rock", "Jazz"}));
    EXPECT_EQ(folder.get("Jazz.dat"), entries({{"Miles", "", "2", ""}, {"Bird", "", "1", ""}}));
    EXPECT_EQ(folder.get("Jazz.art"), articles({{"Miles", "M001"}, {"Bird", "B001"}}));
    EXPECT_EQ(folder.get("Jazz.arn"), crlf({"M#002", "B#002"}));
    EXPECT_EQ(folder.get("Jazz.inf"), " 1 \r\n");

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
        SCOPED_TRACE(c.list + " " + c.csv);
        r = import(c.list, c.csv);
        if (c.err.empty()) continue;
        EXPECT_EQ(r.status, 1);
        EXPECT_EQ(r.err, "pemla: " + c.err + "\n");
    }
    EXPECT_EQ(folder.get("pemla.dat"), crlf({"Rock", "Jazz", "Sal\xE9"}));
    EXPECT_EQ(folder.get(catalogue::articleFile("Sal\xE9")), articles({{"\xE9t\xE9", "!001"}}));
    for (const char* list : {"Blues", "type"}) EXPECT_FALSE(folder.has(catalogue::entryFile(list)));
}

TEST_F(Commands, ImportStopsAtTheListsCap) {
    std::string full;
    for (int i = 1; i < catalogue::kMaxEntries; ++i) {
        full += entries({{"T" + std::to_string(i), "", "", ""}});
    }
    folder.put("Rock.dat", full);
    const Outcome r = import("Rock", "title\r\nLast\r\nOne more\r\n");
    EXPECT_EQ(r.status, 3);
    EXPECT_EQ(r.err, "pemla: " + folder.file("in.csv") + " line 3: " + catalogue::kListFull + "\n");
    EXPECT_EQ(folder.get("Rock.dat"), full + entries({{"Last", "", "", ""}}));
}

// Rock's titles with commas, quotes and accents go out as UTF-8 CSV in the list's order and come
// back in that order into a new list, with new numbers.
TEST_F(Commands, CsvRoundTrip) {
    folder.put("Rock.dat", kRockDat + entries({{"Zoo, \"live\"", "LP", "2", "x"},
                                               {"\xE9t\xE9", "CD", "1", " padded "}}));
    folder.put("Rock.art", kRockArt + articles({{"Zoo, \"live\"", "Z001"}, {"\xE9t\xE9", "!001"}}));
    const std::string csv =
        "title,type,discs,information,article number\r\n"
        "Abba Gold,Music CD,1,Original,A001\r\n"
        "\"Zoo, \"\"live\"\"\",LP,2,x,Z001\r\n"
        "\xC3\xA9t\xC3\xA9,CD,1,\" padded \",!001\r\n";
    Outcome r = run(folder.path(), {"export", "Rock", "--csv"});
    EXPECT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(r.out, csv);
    r = run(folder.path(), {"export", "--csv", "Rock", "--output", folder.file("rock.csv")});
    EXPECT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(folder.get("rock.csv"), csv);
    r = run(folder.path(), {"import", "Copy", folder.file("rock.csv")});
    EXPECT_EQ(r.status, 0) << r.err;
    EXPECT_EQ(folder.get("Copy.dat"), entries({{"Abba Gold", "Music CD", "1", "Original"},
                                               {"Zoo, \"live\"", "LP", "2", "x"},
                                               {"\xE9t\xE9", "CD", "1", " padded "}}));
    EXPECT_EQ(folder.get("Copy.art"),
              articles({{"Abba Gold", "A001"}, {"Zoo, \"live\"", "Z001"}, {"\xE9t\xE9", "!001"}}));
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
             "\" could not be written: No such file or "
             "directory."},
        {{"export", "Rock", "--csv"},
         "The file \"Rock.art\" could not be used: No such file or "
         "directory."},
    };
    std::filesystem::remove(folder.file("Rock.art"));
    for (const auto& c : cases) {
        const Outcome r = run(folder.path(), c.args);
        EXPECT_EQ(r.status, 1) << c.err;
        EXPECT_EQ(r.err, "pemla: " + c.err + "\n");
        EXPECT_EQ(r.out, "");
    }
    EXPECT_EQ(folder.get("Rock.dat"), kRockDat);
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
    EXPECT_EQ(folder.get("Rock.dat"), kRockDat);
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
            f.main.folder.put("export.dat", export_test::settings({f.out.path(), box, box, "1", "0",
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
        EXPECT_NE(written.find("Top text"), std::string::npos);
    }
}

}  // namespace
