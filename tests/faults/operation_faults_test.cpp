// Every operation that writes, driven through its window handler: one system call at a time is
// made to fail, or the process is killed at one step, and the folder must then hold exactly the
// old files (and the user was told) or exactly the new ones; a failed operation succeeds when
// tried again.
#include <gtest/gtest.h>

#include <cerrno>
#include <chrono>
#include <filesystem>

#include "catalogue/file_text.h"
#include "catalogue/list_import.h"
#include "tests/faults/fault_rig.h"

namespace faults {
namespace {

using ui::Answer;

struct Operation {
    const char* name;
    const char* list;   // opened before the action, if any
    const char* entry;  // selected before the action, if any
    bool exportDialog;  // opened before the action
    std::vector<Answer> answers;
    void (*act)(Rig&);
    bool onlyList = false;      // the index holds "Solo" alone
    bool earlierBuild = false;  // "B\xFChne" has files named as an earlier build named them
};

// The user types an entry and presses the button.
void type(Rig& r, const char* title, ui::memory::MemoryButton& button) {
    r.fill({title, "Game", "3", "Copy"});
    button.click();
}
void deleteEntry(Rig& r) {
    r.view.Command_delentry.click();
}
void deleteList(Rig& r) {
    r.view.Command_delete.click();
}
// A retry opens the dialog again, since every closing saves.
void saveExportSettings(Rig& r) {
    if (!r.exportView.window.isLoaded()) r.view.Command_export.click();
    r.exportView.Text2.type("\b\b25");
    r.exportView.window.userClose();
}
void writeReport(Rig& r) {
    r.exportView.Command1.click();
}
// An import as the command runs it, its failures shown as the command prints them.
void importRows(Rig& r, const char* list) {
    r.form->guarded([&] {
        const std::string rows = "title,type\r\nDylan,LP\r\nMiles,dup\r\n\"Zappa, Frank\",CD\r\n";
        const catalogue::ImportResult result = catalogue::importCsv(r.store, list, rows);
        if (!result.problem.empty()) r.platform.messageBox(result.problem, 16, "Error");
    });
}
void restart(Rig& r) {
    if (r.view.window.isLoaded()) r.view.window.unload();
    r.start();
}

const Answer kYes = Answer::Yes;
// clang-format off
const Operation kOperations[] = {
    {"AddEntry", "Rock", nullptr, false, {}, [](Rig& r) { type(r, "Dylan", r.view.Command_add); }},
    {"ChangeKeepingTheLetter", "Rock", "abc", false, {kYes},
     [](Rig& r) { type(r, "Abbey Road", r.view.Command_change); }},
    {"ChangeToAnotherLetter", "Rock", "abc", false, {kYes},
     [](Rig& r) { type(r, "Zappa", r.view.Command_change); }},
    {"DeleteOneOfSeveralEntries", "Rock", "xabc", false, {kYes}, deleteEntry},
    {"DeleteTheOnlyEntry", "Solo", "Miles", false, {kYes}, deleteEntry},
    {"DeleteOneOfSeveralLists", "Jazz", nullptr, false, {kYes, kYes}, deleteList},
    {"DeleteTheOnlyList", "Solo", nullptr, false, {kYes, kYes}, deleteList, true},
    {"CreateList", nullptr, nullptr, false, {}, [](Rig& r) { r.createList("Blues"); }},
    {"SaveExportSettings", "Rock", nullptr, true, {}, saveExportSettings},
    {"WriteReportAsText", "Rock", nullptr, true, {Answer::Ok}, writeReport},
    {"ImportIntoAList", nullptr, nullptr, false, {}, [](Rig& r) { importRows(r, "Solo"); }},
    {"ImportIntoANewList", nullptr, nullptr, false, {}, [](Rig& r) { importRows(r, "Blues"); }},
    {"RenameFilesOfAnEarlierBuild", nullptr, nullptr, false, {}, restart, false, true},
};
// clang-format on

void PrintTo(const Operation& op, std::ostream* out) {
    *out << op.name;
}

// Rock has five entries, Jazz the skeleton, Solo one entry; the export settings name the
// output folder, with every box clear. (A page goes through the same write as a text report.)
void setUp(Rig& r, const Operation& op) {
    putRock(r.folder, {"Jazz"});
    r.folder.putList("Solo", entryText({{"Miles", "Music CD", "1", "Original"}}),
                     crlf({"Miles#*\\M001"}), crlf({"M#002"}));
    r.folder.put("pemla.dat", op.onlyList ? crlf({"Solo"}) : crlf({"Rock", "Jazz", "Solo"}));
    r.folder.put("export.dat", crlf({r.out.path(), "0", "0", "0", "0", "0", "0", "10", "Top"}));
    if (op.earlierBuild) {
        r.folder.putList("B\xFChne", kAbbaDat, crlf({"Abba Gold#*\\A001"}), crlf({"A#002"}));
        r.folder.put("pemla.dat", crlf({"Rock", "B\xFChne"}));
        return;  // the start is the operation
    }
    r.start();
    if ((op.list != nullptr && !r.open(op.list)) || (op.entry != nullptr && !r.select(op.entry)) ||
        (op.exportDialog && !r.view.Command_export.click())) {
        throw std::runtime_error("set-up failed");
    }
}

void runAction(Rig& r, const Operation& op, bool errorBoxScripted) {
    for (Answer answer : op.answers) r.platform.answer(answer);
    if (errorBoxScripted) r.platform.answer(Answer::Ok);
    op.act(r);
}

// Two files live outside any transaction: the name probe of "Create", and a report's temporary
// file in the output folder. A failure or a kill may leave them until the next start, which
// removes them.
bool dropStrays(Files& files) {
    return std::erase_if(files, [](const auto& item) {
               return item.first.ends_with(".del") ||
                      (item.first.starts_with("out/") &&
                       item.first.ends_with(catalogue::kTempSuffix));
           }) > 0;
}

// The files before and after the operation when nothing fails.
std::pair<Files, Files> reference(const Operation& op) {
    Rig r;
    setUp(r, op);
    const Files before = r.files();
    runAction(r, op, false);
    EXPECT_TRUE(r.errors().empty()) << r.errors().front().prompt;
    EXPECT_NE(before, r.files()) << "the operation changed nothing";
    return {before, r.files()};
}

// The file an error box names: `The file "X" could not be used: ...`, or at the start
// `Pemla cannot start: the file "X" ...`.
std::string namedFile(const std::string& prompt) {
    const std::size_t at = prompt.find("file \"");
    if (at == std::string::npos) return {};
    const std::size_t lead = at + std::string("file \"").size();
    return prompt.substr(lead, prompt.find('"', lead) - lead);
}

class OperationFaults : public ::testing::TestWithParam<Operation> {};

TEST_P(OperationFaults, AFailingCallLeavesTheOldFilesAndSaysSoOrTheNewFiles) {
    const Operation& op = GetParam();
    const auto [before, after] = reference(op);
    for (SysCall kind : test_support::kAllSysCalls) {
        for (int n = 1;; ++n) {
            SCOPED_TRACE(std::string(test_support::sysCallName(kind)) + " #" + std::to_string(n));
            Rig r;
            setUp(r, op);
            r.sys.failNext(kind, n, EIO);
            runAction(r, op, true);
            Files left = r.files();
            if (!r.sys.fired()) {
                EXPECT_EQ(left, after) << difference(left, after);
                break;
            }
            catalogue::Store(r.folder.path()).recover();
            Files now = r.files();
            dropStrays(left);
            EXPECT_FALSE(dropStrays(now)) << "a stray file after the start";
            // The operation itself leaves a whole set: nothing waits for the next start.
            EXPECT_EQ(left, now) << difference(left, now);
            const auto errors = r.errors();
            if (now == before) {
                ASSERT_EQ(errors.size(), 1u) << "a failure nobody was told of";
                EXPECT_EQ(errors.front().style, 16);
                const std::string file = namedFile(errors.front().prompt);
                EXPECT_TRUE(file.empty() || before.contains(file) || after.contains(file) ||
                            after.contains("out/" + file) || file == catalogue::kJournalName ||
                            file == r.folder.path() || file == r.out.path())
                    << errors.front().prompt;
                runAction(r, op, false);
                Files retried = r.files();
                dropStrays(retried);
                EXPECT_EQ(retried, after) << "retry:" << difference(retried, after);
                EXPECT_EQ(r.errors().size(), 1u);
            } else if (now == after && !errors.empty()) {
                // Done; only a failed read while showing the result may still be reported.
                const std::string& path = r.sys.hit()->path;
                EXPECT_TRUE(r.sys.hit()->reading) << errors.front().prompt;
                EXPECT_TRUE(path.ends_with("/" + namedFile(errors.front().prompt))) << path;
            } else if (now != after) {
                ADD_FAILURE() << "neither old nor new:" << difference(before, now);
            }
        }
    }
}

TEST_P(OperationFaults, AKillAtAnyStepRecoversToTheOldOrTheNewFiles) {
    const Operation& op = GetParam();
    const auto [before, after] = reference(op);
    for (int step = 1;; ++step) {
        SCOPED_TRACE("killed at step " + std::to_string(step));
        Rig r;
        setUp(r, op);
        const int status = inChild([&] {
            r.sys.killAt(step);
            runAction(r, op, false);
        });
        // What the program does first when it starts again.
        catalogue::Store(r.folder.path()).recover();
        Files now = r.files();
        if (!killed(status)) {
            // The operation ran to its end before the step came.
            EXPECT_EQ(status, 0);
            EXPECT_EQ(now, after) << difference(now, after);
            break;
        }
        EXPECT_FALSE(dropStrays(now)) << "a name probe or report copy left after the start";
        EXPECT_TRUE(now == after || now == before) << difference(before, now);
    }
}

// Another program rewrites the open list's entry file (or, for a list deletion, the index) after
// the window read it, longer or to the same size: the operation writes nothing, says so, and
// shows the files as they are, keeping what the user typed into the information box.
class OpenListOperations : public OperationFaults {};

TEST_P(OpenListOperations, AFileChangedBehindTheWindowIsNeverReplaced) {
    const Operation& op = GetParam();
    const bool types = std::string_view(op.name).starts_with("Add") ||
                       std::string_view(op.name).starts_with("Change");
    std::vector<std::string> files = {std::string(op.list) + ".dat"};
    if (op.act == deleteList) files.push_back("pemla.dat");
    for (const std::string& file : files) {
        for (const bool sameSize : {false, true}) {
            SCOPED_TRACE(file + (sameSize ? ", same size" : ", longer"));
            Rig r;
            setUp(r, op);
            std::string bytes = r.files().at(file);
            if (sameSize) {
                bytes[bytes.size() - 3] ^= 1;  // a letter of the last line
            } else {
                bytes +=
                    file == "pemla.dat" ? crlf({"Blues"}) : entryText({{"Behind", "CD", "1", "x"}});
            }
            r.folder.put(file, bytes);
            const auto path = std::filesystem::path(r.folder.file(file));
            std::filesystem::last_write_time(
                path, std::filesystem::last_write_time(path) + std::chrono::seconds(2));
            const Files before = r.files();
            const std::string information = r.view.Combo3.text();
            runAction(r, op, true);
            EXPECT_EQ(r.files(), before) << difference(before, r.files());
            ASSERT_EQ(r.errors().size(), 1u);
            EXPECT_EQ(namedFile(r.errors().front().prompt), file);
            const auto& shown = file == "pemla.dat" ? r.view.List_list : r.view.List1;
            EXPECT_EQ(shown.items().size(),
                      catalogue::splitLines(bytes).size() / (file == "pemla.dat" ? 1 : 4));
            EXPECT_EQ(r.view.Combo3.text(), types ? "Copy" : information);
        }
    }
}

// Two failed calls in a row after the commit point leave the change in the journal. What the user
// does next still ends in a whole catalogue: the change finished or not made, then the next one
// on the files as they are (the user opens "Rock" and tries to add "Dylan" five times: each failed
// call costs at most one try, and a window left stale by them one more). With four failures the
// journal cannot be finished for a while, and writes are refused naming it.
class WindowOperations : public OperationFaults {};

TEST_P(WindowOperations, TwoFailuresPastTheCommitPointThenAnotherOperationLeaveAWholeCatalogue) {
    const Operation& op = GetParam();
    const auto addDylanToRock = [](Rig& r) {
        r.view.List_list.userSelect("Rock");  // gone where the operation deleted it
        for (int i = 0; i < 5; ++i) r.addDylan();
    };
    Files withOp, withoutOp;
    for (Files* files : {&withOp, &withoutOp}) {
        Rig r;
        setUp(r, op);
        if (files == &withOp) runAction(r, op, false);
        addDylanToRock(r);
        *files = r.files();
    }
    int unfinished = 0, refusedStuck = 0;
    for (int times : {2, 4}) {
        for (int n = 1;; ++n) {
            SCOPED_TRACE("renames #" + std::to_string(n) + " and " + std::to_string(times - 1) +
                         " after it fail");
            Rig r;
            setUp(r, op);
            r.sys.failNext(SysCall::Rename, n, EIO, times);
            runAction(r, op, true);
            if (!r.sys.fired()) break;
            addDylanToRock(r);
            // Only where Rock is listed did a write come after the failures to finish the journal.
            EXPECT_TRUE(op.onlyList || !hasLeftovers(r.files())) << "something half-done is left";
            catalogue::Store(r.folder.path()).recover();
            const Files now = r.files();
            EXPECT_TRUE(now == withOp || now == withoutOp)
                << difference(withOp, now) << " /" << difference(withoutOp, now)
                << (now.count("Rock.dat") ? now.at("Rock.dat") + now.at("Rock.art") : "");
            for (const auto& box : r.errors()) {
                unfinished += box.prompt.find("window now shows the files") != std::string::npos;
                refusedStuck += namedFile(box.prompt) == catalogue::kJournalName;
            }
        }
    }
    EXPECT_GT(unfinished, 0);
    EXPECT_GT(refusedStuck, 0);
}

INSTANTIATE_TEST_SUITE_P(Window, OperationFaults, ::testing::ValuesIn(kOperations),
                         [](const auto& info) { return std::string(info.param.name); });
// The operations on the open list, and with "Create" those that commit several files at once.
INSTANTIATE_TEST_SUITE_P(Window, OpenListOperations,
                         ::testing::ValuesIn(kOperations, kOperations + 7),
                         [](const auto& info) { return std::string(info.param.name); });
INSTANTIATE_TEST_SUITE_P(Window, WindowOperations,
                         ::testing::ValuesIn(kOperations, kOperations + 8),
                         [](const auto& info) { return std::string(info.param.name); });

}  // namespace
}  // namespace faults
