#pragma once

#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "catalogue/store.h"
#include "export/form_export.h"
#include "main_window/form1.h"
#include "new_list/form_new_list.h"
#include "tests/support/faulty_sys.h"
#include "tests/support/memory_dialogs.h"
#include "tests/support/memory_form1.h"
#include "tests/support/temp_folder.h"

// The program's windows on memory controls over a catalogue folder, with the means to make one
// system call fail, to kill the process at one step, and to compare whole folders.
namespace faults {

// Every file of a folder by name: its bytes, or a marker for a folder or a symbolic link.
using Files = std::map<std::string, std::string>;

// The folder's files, each name after `prefix`; temporary files and the journal included.
Files snapshot(const std::string& folder, const std::string& prefix = {});
// The names that differ between two snapshots (" +name": only in the second), for a message.
std::string difference(const Files& a, const Files& b);
// Whether a temporary file or a journal is among the files.
bool hasLeftovers(const Files& files);

// The real calls with one planned fault counted from the moment it is planned: a failing call,
// or SIGKILL before a step. Remembers the call the fault hit.
class RigSys : public test_support::FaultySys {
  public:
    struct Hit {
        std::string path;
        bool reading;  // an open for reading, a read, or the close of a file opened for reading
    };
    // The n-th call of `kind` from now on fails with `errnum`, and the `times` - 1 after it.
    void failNext(test_support::SysCall kind, int n, int errnum, int times = 1) {
        failAt(kind, calls(kind) + n, errnum, times);
    }
    // The n-th call of any kind from now on kills the process before it is made.
    void killAt(int n) { killStep_ = steps() + n; }
    const std::optional<Hit>& hit() const { return hit_; }

    int open(const std::string& path, int flags, mode_t mode) override;
    ssize_t read(int fd, void* buffer, size_t size) override;
    ssize_t write(int fd, const void* buffer, size_t size) override;
    int fsync(int fd) override;
    int close(int fd) override;
    int rename(const std::string& from, const std::string& to) override;
    int unlink(const std::string& path) override;

  private:
    template <class Call>
    auto pass(const Hit& file, Call call);

    std::optional<Hit> hit_;
    std::map<int, Hit> files_;  // open descriptors
    int killStep_ = 0;
};

// Runs `body` in a forked child that ends with _exit(0) when it returns and _exit(100) when it
// throws; returns the wait status. With `killAfterMs`, the child is killed that long after.
int inChild(const std::function<void()>& body, int killAfterMs = -1);
// Whether the wait status is that of a process killed with SIGKILL.
bool killed(int status);

// Entries as the entry file holds them: four tagged lines each, from title/type/discs/info rows.
std::string entryText(const std::vector<std::vector<std::string>>& rows);
// Lines, each followed by CR LF.
std::string crlf(const std::vector<std::string>& lines);
// "Abba Gold", the one entry of the list "Rock" that most tests start from.
inline const std::string kAbbaDat = entryText({{"Abba Gold", "Music CD", "1", "Original"}});

// A catalogue folder and an output folder, and the windows on them, every call going through
// `sys`.
class Rig {
  public:
    // A fresh folder holding the suggestion files and an empty index, and an output folder;
    // or, given a folder, the windows over it alone (a killed child leaves nothing behind).
    explicit Rig(const std::string& existing = {});

    void put(const std::string& name, const std::string& bytes) const;
    // A list's entry, article and counter files and its flag " 1 ".
    void putList(const std::string& name, const std::string& entries, const std::string& articles,
                 const std::string& counter) const {
        put(name + ".dat", entries);
        put(name + ".art", articles);
        put(name + ".arn", counter);
        put(name + ".inf", " 1 \r\n");
    }
    // The list "Rock" holding "Abba Gold", and the index `index`.
    void putRock(const std::string& index = "Rock\r\n") const {
        putList("Rock", kAbbaDat, crlf({"Abba Gold#*\\A001"}), crlf({"A#002"}));
        put("pemla.dat", index);
    }
    // The main window's start-up.
    void start() { view.window.show(); }
    // The user selects a list, or an entry of the open list; false when it is not shown.
    bool open(const std::string& list) { return view.List_list.userSelect(list); }
    bool select(const std::string& title) { return view.List1.userSelect(title); }
    // The user clears the entry fields and types these values.
    void fill(const std::string& title, const std::string& type, const std::string& discs,
              const std::string& information);
    // The user adds "Dylan" with this information to the open list, or deletes the open list
    // confirming twice; an error box, should one come, is answered.
    void addDylan(const std::string& information = "x") {
        platform.answer(ui::Answer::Ok);
        fill("Dylan", "Game", "1", information);
        view.Command_add.click();
    }
    void deleteList() {
        for (ui::Answer a : {ui::Answer::Yes, ui::Answer::Yes, ui::Answer::Ok}) platform.answer(a);
        view.Command_delete.click();
    }
    // The user opens the new-list dialog, types the name and presses "Create".
    void createList(const std::string& name) {
        view.Command_create.click();
        newListView.Text1.type(name);
        newListView.Command1.click();
    }

    // The catalogue folder's files, and the output folder's under "out/", whose path in them
    // reads "<out>" (every rig has its own).
    Files files() const;
    // The message boxes titled "Error" shown so far.
    std::vector<ui::memory::MemoryPlatform::Shown> errors() const;

  private:
    std::unique_ptr<test_support::TempFolder> own_, ownOut_;

  public:
    std::string folder, out;
    RigSys sys;
    catalogue::Store store;
    ui::memory::MemoryPlatform platform;
    test_support::MemoryForm1 view;
    main_window::Form1 form;
    test_support::MemoryNewList newListView;
    new_list::Form_new_list newList;
    test_support::MemoryFormExport exportView;
    exporting::Form_Export exporter;
};

}  // namespace faults
