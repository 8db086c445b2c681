// The names "Create" takes for a new list and those it refuses, tried on a real folder: a refusal
// leaves every file as it was, the name's probe file included.
#include <gtest/gtest.h>

#include <cerrno>

#include "catalogue/entry_rules.h"
#include "catalogue/journal.h"
#include "catalogue/store.h"
#include "tests/support/faulty_sys.h"
#include "tests/support/temp_folder.h"

namespace catalogue {
namespace {

using test_support::SysCall;

TEST(ListNames, InUseReservedOrNoPortableFileNameAreRefusedTheRestTaken) {
    // The index, and for each name what "Create" says: in use ignoring case, a name a listed name
    // ends with, every reserved word in any case and every trailing part of one, the empty name;
    // no file name on every system; names that only begin like a list or hold a reserved word.
    // A full index is the list edits' test.
    const std::string inUse = "Hard Rock\r\nPop\r\n", blankAndNoLastCrLf = "Hard Rock\r\n\r\nOld";
    const std::tuple<std::string, std::vector<std::string>, std::string> cases[] = {
        {inUse,
         {"", "hard ROCK", "Rock", "k", " Rock", "EXPORT", "Print", "pemla", "iNFORMATION", "type",
          "port", "ation", "e", "MLA"},
         kNameInUse},
        {inUse,
         {"a/b", "a\\b", "C:", "why?", "*", "<x", "x>", "say \"hi\"", "a|b", "tab\there",
          std::string("nul\0x", 5), "del\x7f", "c1\x85", ".", ".."},
         kBadName},
        {blankAndNoLastCrLf, {"Hard", "exports", "myexport", "xpor", "Type A", "a.b", "..."}, ""},
    };
    for (const auto& [index, names, refusal] : cases) {
        test_support::TempFolder folder;
        folder.put("pemla.dat", index);
        // Files the user made that a probe would be named: they prove a name usable and stay.
        folder.put("type.del", "mine");
        folder.put("myexport.del", "mine");
        Store store(folder.path());
        for (const std::string& name : names) {
            EXPECT_EQ(checkNewListName(store, name).refusal, refusal) << "name \"" << name << "\"";
            EXPECT_EQ(folder.listing(), "myexport.del\npemla.dat\ntype.del\n") << name;
        }
        EXPECT_EQ(folder.get("pemla.dat") + folder.get("type.del") + folder.get("myexport.del"),
                  index + "minemine");
    }
}

// A file system that refuses the probe file (its open comes after the journal's), or will not
// delete it even when asked twice: the name is refused, and the probe and its record are left
// for the next start, which removes them.
TEST(ListNames, AProbeTheFolderRefusesIsLeftToTheNextStart) {
    for (const SysCall kind : {SysCall::Open, SysCall::Unlink}) {
        SCOPED_TRACE(test_support::sysCallName(kind));
        test_support::TempFolder folder;
        folder.put("pemla.dat", "Pop\r\n");
        test_support::FaultySys sys;
        sys.failAt(kind, kind == SysCall::Open ? 2 : 1, kind == SysCall::Open ? EINVAL : EACCES, 2);
        Store store(folder.path(), sys);
        EXPECT_EQ(checkNewListName(store, "Jazz").refusal, kBadName);
        EXPECT_TRUE(sys.fired());
        Store(folder.path()).recover();
        EXPECT_EQ(folder.listing(), "pemla.dat\n");
    }
}

}  // namespace
}  // namespace catalogue
