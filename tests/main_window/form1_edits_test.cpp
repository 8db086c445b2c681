// "Add", "Change", "Delete entry" and "Delete list" as the window shows them: the questions it
// asks, its answers to a refusal, and the lists and fields afterwards. What each leaves in the
// files is the catalogue suite's.
#include "bench/catalogue_maker.h"
#include "catalogue/entry_rules.h"
#include "catalogue/journal.h"
#include "tests/main_window/form1_test_fixture.h"

namespace main_window_test {
namespace {

// With no list open "Add" says so; on a list it shows the new title and empties the fields, or
// keeps them with the refusal. Nothing refused is written.
TEST_F(Form1Test, AddShowsTheNewTitleAndEmptiesTheFieldsOrKeepsThemWithTheRefusal) {
    putRock(folder);
    start();
    Files before = files();
    fill({"Orphan", "CD", "1", ""});
    press(view.Command_add, {Answer::Ok});
    expectBox(0, 16, "Error",
              "No list is open, so the title was not added. Select the list to add it to, then "
              "press Add again.");
    EXPECT_EQ(fields(), "Orphan|CD|1||");
    EXPECT_EQ(files(), before);

    open("Rock");
    fill({"Blues", "Music CD", "2", "Copy"});
    view.Command_add.click();
    EXPECT_EQ(titles(), (Strings{"1st", "abc", "abcd", "Blues", "xabc", "Zebra"}));
    expectReset();
    EXPECT_EQ(folder.get("Rock.dat"),
              entryText(kRock) + entryText({{"Blues", "Music CD", "2", "Copy"}}));

    // Every refusal of the catalogue is shown the same way; a title already in the list stands
    // for them all.
    before = files();
    fill({"ABC", "CD", "1", "Copy"});
    press(view.Command_add, {Answer::Ok});
    expectBox(1, 16, "Error", catalogue::kDuplicateTitle);
    EXPECT_EQ(fields(), "ABC|CD|1|Copy|");
    EXPECT_TRUE(view.Text1.hasFocus());
    EXPECT_EQ(files(), before);
}

// A list at its largest (32767 entries of about 100 bytes): the window counts the titles it
// shows, and refuses another.
TEST_F(Form1Test, AFullListRefusesAnAdd) {
    bench::writeList(folder.path(), "Big", catalogue::kMaxEntries);
    folder.put("pemla.dat", "Big\r\n");
    start();
    open("Big");
    EXPECT_EQ(view.Label2.caption(), "... amount:  32767 ...");
    const Files before = files();
    fill({"One too many", "CD", "1", ""});
    press(view.Command_add, {Answer::Ok});
    expectBox(0, 16, "Error", catalogue::kListFull);
    EXPECT_EQ(files(), before);
}

TEST_F(Form1Test, ChangeAsksFirstAndShowsTheChangedTitle) {
    startWithRock();
    const Files before = files();
    press(view.Command_change, {Answer::Ok});
    expectBox(0, 16, "Error", "Select the entry to change in the list first.");

    // A value the files cannot hold is refused before the question.
    select("abc");
    retype(view.Combo1, "a<|*");
    press(view.Command_change, {Answer::Ok});
    expectBox(1, 16, "Error");

    select("abc");
    retype(view.Combo1, "LP");
    press(view.Command_change, {Answer::No});
    expectBox(2, 4, "Change item", "Are ya sure yo want to change selected entry?");
    expectReset();
    EXPECT_EQ(files(), before);

    select("abc");
    retype(view.Text1, "Quartz");
    press(view.Command_change, {Answer::Yes});
    EXPECT_EQ(titles(), (Strings{"1st", "abcd", "Quartz", "xabc", "Zebra"}));
    expectReset();
}

// The fields keep a deleted entry's values, but the only entry of a list gives way to the
// placeholder and the fields are emptied.
TEST_F(Form1Test, DeleteEntryAsksFirstAndKeepsTheDeletedValuesOrShowsThePlaceholder) {
    startWithRock({"Solo"});
    const Files before = files();
    view.Command_delentry.click();  // nothing selected: nothing asked (no box is scripted)
    select("abc");
    press(view.Command_delentry, {Answer::No});
    expectBox(0, 260, "Change item", "Are ya sure yo want to DELETE selected entry?");
    EXPECT_EQ(fields(), "abc|Game|3||A002");
    EXPECT_EQ(files(), before);

    select("xabc");
    press(view.Command_delentry, {Answer::Yes});
    EXPECT_EQ(fields(), "xabc|CD|10|x|X001");

    folder.putList("Solo", entryText({{"Jazz Album", "CD", "2", "Copy"}}),
                   articleText({{"Jazz Album", "J001"}}), crlf({"J#002"}), " 0 \r\n");
    open("Solo");
    select("Jazz Album");
    press(view.Command_delentry, {Answer::Yes});
    expectReset();
    select("Add an item and delete me!");
    EXPECT_EQ(fields(), "Add an item and delete me!|DELETE ME!|DELETE ME!|DELETE ME!|A001");
}

// Each add, change and delete moves one title in the list box; the list then shows exactly what
// a refill from the written file shows, and the next change finds that file as the window left
// it. Selecting "ABC" changes or deletes the file's first "abc" in any case, as the file says.
TEST_F(Form1Test, AnEditedListEqualsAFullRefill) {
    startWithRock();
    // Title selected, title typed: an add without a selection, a delete without a title.
    const std::vector<std::pair<std::string, std::string>> steps = {
        {"", "0 first"}, {"", "Mmm"},    {"", "zzz"},         {"", "\xC9t\xE9"},
        {"xabc", "ABC"}, {"ABC", "Abc"}, {"0 first", "zzzz"}, {"\xC9t\xE9", "\xE9t\xE9"},
        {"zzzz", ""},    {"ABC", ""},    {"1st", ""},         {"\xE9t\xE9", ""}};
    for (const auto& [selected, title] : steps) {
        SCOPED_TRACE(selected + " -> " + title);
        if (selected.empty()) {
            fill({title, "CD", "1", ""});
            view.Command_add.click();
        } else {
            ASSERT_TRUE(select(selected));
            if (!title.empty()) retype(view.Text1, title);
            press(title.empty() ? view.Command_delentry : view.Command_change, {Answer::Yes});
        }
        ui::memory::MemoryListBox refill;
        refill.setItems(*catalogue::entryTitles(folder.get("Rock.dat")));
        EXPECT_EQ(titles(), refill.items());
        EXPECT_EQ(view.List1.selectedIndex(), -1);
        EXPECT_EQ(view.Label2.caption(), "... amount:  " + std::to_string(refill.count()) + " ...");
    }
}

TEST_F(Form1Test, DeleteListAsksTwiceAndShowsTheListsLeft) {
    putRock(folder, {"Jazz"});
    start();
    const Files before = files();
    view.Command_delete.click();  // nothing selected: nothing asked
    open("Rock");
    press(view.Command_delete, {Answer::No});
    expectBox(0, 260, "DELETE?", "ARE YA SURE YA WANT TO DELETE THE SELECTED LIST?");
    press(view.Command_delete, {Answer::Yes, Answer::No});
    expectBox(2, 308, "DELETE?", "ARE YA REALLY SURE?");
    EXPECT_EQ(files(), before);

    for (const std::string list : {"Rock", "Jazz"}) {
        open(list);
        press(view.Command_delete, {Answer::Yes, Answer::Yes});
    }
    const std::string placeholder(catalogue::kPlaceholderList);
    EXPECT_EQ(view.List_list.items(), (Strings{placeholder}));
    EXPECT_EQ(view.List_list.selectedIndex(), -1);
    EXPECT_TRUE(titles().empty());
}

// Each writing button, once its questions are answered, first finishes a change that an earlier
// run left unfinished, says so, and stops there: it writes nothing else. Opening a list finishes
// it quietly.
TEST_F(Form1Test, EveryEditFinishesAnEarlierChangeFirstAndStops) {
    startWithRock({"Jazz"});
    const Files before = files();
    const std::pair<ui::memory::MemoryButton*, std::vector<Answer>> buttons[] = {
        {&view.Command_add, {Answer::Ok}},
        {&view.Command_change, {Answer::Ok}},
        {&view.Command_delentry, {Answer::Yes, Answer::Ok}},
        {&view.Command_delete, {Answer::Yes, Answer::Yes, Answer::Ok}}};
    // The earlier change deletes a file; the next step finds it recorded and does it first.
    const auto leaveAChange = [&] {
        folder.put("left.del", "");
        folder.put(std::string(catalogue::kJournalName),
                   catalogue::encodeJournal({{}, {"left.del"}, {}}));
        return platform.shown().size();
    };
    for (const auto& [button, answers] : buttons) {
        select("abc");
        fill({"New", "CD", "1", ""});
        const std::size_t boxes = leaveAChange();
        press(*button, answers);
        ASSERT_EQ(platform.shown().size(), boxes + answers.size()) << button->caption();
        EXPECT_TRUE(platform.shown().back().prompt.starts_with(
            "An earlier change that was left unfinished has now been completed, so nothing else "
            "was done."))
            << platform.shown().back().prompt;
        EXPECT_EQ(files(), before) << button->caption();
    }
    // Opening a list finishes one as well, without a word (no box is scripted).
    leaveAChange();
    open("Jazz");
    EXPECT_EQ(files(), before);
}

}  // namespace
}  // namespace main_window_test
