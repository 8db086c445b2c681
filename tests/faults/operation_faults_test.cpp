// Every operation that writes, driven through its window handler: one system call at a time is
// made to fail, or the process is killed at one step, and the folder must then hold exactly the
// old files (and the user was told) or exactly the new ones; a failed operation succeeds when
// tried again.
#include <gtest/gtest.h>

#include <cerrno>
#include <iostream>
#include <stdexcept>

#include "tests/faults/fault_rig.h"

namespace faults {
namespace {

using test_support::FaultySys;
using test_support::SysCall;
using ui::Answer;

void need(bool done, const char* what) {
    if (!done) throw std::runtime_error(std::string("set-up failed: ") + what);
}

struct Operation {
    const char* name;
    bool onlyList;      // the index holds "Solo" alone
    const char* list;   // opened before the action, if any
    const char* entry;  // selected before the action, if any
    int exportDialog;   // -1: closed; 0, 1: open on text or HTML settings
    std::vector<Answer> confirmations;
    void (*act)(Rig&);  // the user's action
};

void PrintTo(const Operation& op, std::ostream* out) {
    *out << op.name;
}

// Rock has three entries, Jazz the skeleton, Solo one entry.
void setUp(Rig& r, const Operation& op) {
    r.putList("Rock",
              entryText({{"Abba Gold", "Music CD", "1", "Original"},
                         {"Blur", "Game", "2", "Copy"},
                         {"Cream", "DVD video", "1", "x"}}),
              crlf({"Abba Gold#*\\A001", "Blur#*\\B001", "Cream#*\\C001"}),
              crlf({"A#002", "B#002", "C#002"}));
    r.putList("Jazz", std::string(catalogue::kSkeletonEntries),
              std::string(catalogue::kSkeletonArticles));
    r.putList("Solo", entryText({{"Miles", "Music CD", "1", "Original"}}), crlf({"Miles#*\\M001"}),
              crlf({"M#002"}));
    r.put("pemla.dat", op.onlyList ? crlf({"Solo"}) : crlf({"Rock", "Jazz", "Solo"}));
    if (op.exportDialog >= 0) r.putExportSettings(op.exportDialog == 1);
    r.start();
    need(op.list == nullptr || r.open(op.list), "the list");
    need(op.entry == nullptr || r.select(op.entry), "the entry");
    need(op.exportDialog < 0 || r.view.Command_export.click(), "the export dialog");
}

void add(Rig& r) {
    r.fill("Dylan", "DVD video", "2", "Copy");
    r.view.Command_add.click();
}
void changeKeepingTheLetter(Rig& r) {
    r.fill("Abbey Road", "Music CD", "1", "Original");
    r.view.Command_change.click();
}
void changeToAnotherLetter(Rig& r) {
    r.fill("Zappa", "Game", "3", "Copy");
    r.view.Command_change.click();
}
void deleteEntry(Rig& r) {
    r.view.Command_delentry.click();
}
void deleteList(Rig& r) {
    r.view.Command_delete.click();
}
void createList(Rig& r) {
    r.createList("Blues");
}
void saveExportSettings(Rig& r) {
    // A retry opens the dialog again, since every closing saves.
    if (!r.exportView.window.isLoaded()) r.view.Command_export.click();
    r.exportView.Text2.type("\b\b25");
    r.exportView.window.userClose();
}
void writeReport(Rig& r) {
    r.exportView.Command1.click();
}

const Answer kYes = Answer::Yes;
const Operation kOperations[] = {
    {"AddEntry", false, "Rock", nullptr, -1, {}, add},
    {"ChangeKeepingTheLetter", false, "Rock", "Abba Gold", -1, {kYes}, changeKeepingTheLetter},
    {"ChangeToAnotherLetter", false, "Rock", "Abba Gold", -1, {kYes}, changeToAnotherLetter},
    {"DeleteOneOfSeveralEntries", false, "Rock", "Blur", -1, {kYes}, deleteEntry},
    {"DeleteTheOnlyEntry", false, "Solo", "Miles", -1, {kYes}, deleteEntry},
    {"DeleteOneOfSeveralLists", false, "Jazz", nullptr, -1, {kYes, kYes}, deleteList},
    {"DeleteTheOnlyList", true, "Solo", nullptr, -1, {kYes, kYes}, deleteList},
    {"CreateList", false, nullptr, nullptr, -1, {}, createList},
    {"SaveExportSettings", false, "Rock", nullptr, 0, {}, saveExportSettings},
    {"WriteReportAsText", false, "Rock", nullptr, 0, {Answer::Ok}, writeReport},
    {"WriteReportAsHtml", false, "Rock", nullptr, 1, {Answer::Ok}, writeReport},
};

// Two files live outside any transaction and the start-up knows nothing of them: the name probe
// of "Create", and a report's temporary file in the output folder. A failed unlink or a kill
// between their creation and removal leaves them behind, beside a whole old or new set.
bool dropStrays(Files& files) {
    return std::erase_if(files, [](const auto& item) {
               return item.first.ends_with(".del") ||
                      (item.first.starts_with("out/") &&
                       item.first.ends_with(catalogue::kTempSuffix));
           }) > 0;
}

void runAction(Rig& r, const Operation& op, bool errorBoxScripted) {
    for (Answer answer : op.confirmations) r.platform.answer(answer);
    if (errorBoxScripted) r.platform.answer(Answer::Ok);
    op.act(r);
}

// What the operation does when nothing fails, and how many calls of each kind it makes.
struct Reference {
    Files before, after;
    std::map<SysCall, int> calls;
    int steps = 0;
};

Reference reference(const Operation& op) {
    Reference ref;
    Rig r;
    setUp(r, op);
    ref.before = r.files();
    FaultySys counter;
    r.sys.use(counter);
    runAction(r, op, false);
    r.sys.reset();
    ref.after = r.files();
    EXPECT_TRUE(r.errors().empty()) << r.errors().front().prompt;
    EXPECT_NE(ref.before, ref.after) << "the operation changed nothing";
    for (SysCall kind : test_support::kAllSysCalls) ref.calls[kind] = counter.calls(kind);
    ref.steps = counter.steps();
    return ref;
}

// The file an error box names: `The file "X" could not be used: ...`.
std::string namedFile(const std::string& prompt) {
    const std::string lead = "The file \"";
    if (!prompt.starts_with(lead)) return {};
    return prompt.substr(lead.size(), prompt.find('"', lead.size()) - lead.size());
}

class OperationFaults : public ::testing::TestWithParam<Operation> {};

TEST_P(OperationFaults, AFailingCallLeavesTheOldFilesAndSaysSoOrTheNewFiles) {
    const Operation& op = GetParam();
    const Reference ref = reference(op);
    int points = 0, kept = 0, readAfter = 0;
    for (SysCall kind : test_support::kAllSysCalls) {
        for (int n = 1;; ++n) {
            SCOPED_TRACE(std::string(test_support::sysCallName(kind)) + " #" + std::to_string(n));
            Rig r;
            setUp(r, op);
            FaultySys faulty;
            faulty.failAt(kind, n, EIO);
            r.sys.use(faulty, &faulty);
            runAction(r, op, true);
            r.sys.reset();
            if (!faulty.fired()) {
                EXPECT_EQ(n, ref.calls.at(kind) + 1);
                EXPECT_EQ(r.files(), ref.after) << difference(r.files(), ref.after);
                break;
            }
            ++points;
            const RelaySys::Hit hit = *r.sys.hit();
            Files left = r.files();
            catalogue::Store(r.folder).recover();
            Files now = r.files();
            dropStrays(left);
            if (dropStrays(now)) {
                EXPECT_EQ(hit.kind, SysCall::Unlink) << "a stray file";
            }
            // The operation itself leaves a whole set: nothing waits for the next start.
            EXPECT_EQ(left, now) << difference(left, now);
            const auto errors = r.errors();
            if (now == ref.before) {
                ++kept;
                ASSERT_EQ(errors.size(), 1u) << "a failure nobody was told of";
                EXPECT_EQ(errors.front().style, 16);
                const std::string file = namedFile(errors.front().prompt);
                EXPECT_TRUE(file.empty() || ref.before.contains(file) || ref.after.contains(file) ||
                            ref.after.contains("out/" + file) || file == catalogue::kJournalName ||
                            file == r.folder || file == r.out)
                    << errors.front().prompt;
                runAction(r, op, false);
                Files retried = r.files();
                dropStrays(retried);
                EXPECT_EQ(retried, ref.after) << "retry:" << difference(retried, ref.after);
                EXPECT_EQ(r.errors().size(), 1u);
            } else if (now == ref.after) {
                // Done; only a failed read while showing the result may still be reported.
                if (!errors.empty()) {
                    ++readAfter;
                    EXPECT_TRUE(hit.reading) << errors.front().prompt;
                    EXPECT_TRUE(hit.path.ends_with("/" + namedFile(errors.front().prompt)));
                }
            } else {
                ADD_FAILURE() << "neither old nor new:" << difference(ref.before, now);
            }
        }
    }
    std::cout << "[ faults ] " << op.name << ": " << points << " fault points, " << kept
              << " kept the old files and said so, " << points - kept << " finished the change ("
              << readAfter << " then told of a failed read while showing it)\n";
    EXPECT_GT(points, 0);
}

TEST_P(OperationFaults, AKillAtAnyStepRecoversToTheOldOrTheNewFiles) {
    const Operation& op = GetParam();
    const Reference ref = reference(op);
    int points = 0, finished = 0, strays = 0;
    for (int step = 1; step <= ref.steps; ++step) {
        SCOPED_TRACE("killed at step " + std::to_string(step));
        Rig r;
        setUp(r, op);
        const int status = inChild([&] {
            r.sys.killAt(step);
            runAction(r, op, false);
        });
        ASSERT_EQ(describeStatus(status), "killed by signal 9");
        ++points;
        // What the program does first when it starts again.
        catalogue::Store(r.folder).recover();
        Files now = r.files();
        strays += dropStrays(now) ? 1 : 0;
        if (now == ref.after) {
            ++finished;
        } else {
            EXPECT_EQ(now, ref.before) << difference(ref.before, now);
        }
    }
    std::cout << "[ faults ] " << op.name << ": " << points << " kill points, " << finished
              << " recovered to the new files, " << points - finished << " to the old";
    if (strays > 0) std::cout << " (" << strays << " left a name probe or report temporary behind)";
    std::cout << "\n";
    EXPECT_GT(points, 0);
}

INSTANTIATE_TEST_SUITE_P(Window, OperationFaults, ::testing::ValuesIn(kOperations),
                         [](const auto& info) { return std::string(info.param.name); });

}  // namespace
}  // namespace faults
