#pragma once

#include <sys/types.h>

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
#include "ui/memory/memory_controls.h"

// The program's windows on memory controls over a catalogue folder, with the means to make one
// system call fail, to kill the process at one step, and to compare whole folders.
namespace faults {

// Every file of a folder by name: its bytes, or a marker for a folder or a symbolic link.
using Files = std::map<std::string, std::string>;

// The folder's files, each name after `prefix`; temporary files and the journal included.
Files snapshot(const std::string& folder, const std::string& prefix = {});
// The names that differ between two snapshots, for a failure message.
std::string difference(const Files& a, const Files& b);
// The temporary files and journals among the names.
std::vector<std::string> leftovers(const Files& files);

// Forwards every call to a Sys that can be swapped while the windows keep their one store;
// remembers which call a watched FaultySys made fail, and can kill the process at a step.
class RelaySys : public catalogue::Sys {
  public:
    struct Hit {
        test_support::SysCall kind;
        std::string path;
        bool reading;  // an open for reading, a read, or the close of a file opened for reading
    };

    // Sends the calls to `sys` from now on; with `watched`, records the call its fault hits.
    void use(catalogue::Sys& sys, const test_support::FaultySys* watched = nullptr);
    // Back to the real calls; the recorded hit stays.
    void reset() {
        target_ = &catalogue::realSys();
        watched_ = nullptr;
    }
    // The n-th call from now on (of any kind) kills the process with SIGKILL before it is made.
    void killAt(int step) {
        killAt_ = step;
        steps_ = 0;
    }
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
    auto pass(test_support::SysCall kind, const std::string& path, bool reading, Call call);
    std::pair<std::string, bool> fileOf(int fd) const;

    catalogue::Sys* target_ = &catalogue::realSys();
    const test_support::FaultySys* watched_ = nullptr;
    std::optional<Hit> hit_;
    std::map<int, std::pair<std::string, bool>> fds_;  // path, opened for reading
    int killAt_ = 0;
    int steps_ = 0;
};

// Runs `body` in a forked child that ends with _exit(0) when it returns and _exit(100) when it
// throws; returns the child's wait status. With `killAfterMs`, the child is killed with SIGKILL
// that long after it started. Output is flushed first so the child repeats none.
int inChild(const std::function<void()>& body, int killAfterMs = -1);
// The wait status as words: "killed by signal 9", "exit 0".
std::string describeStatus(int status);

// The dialogs' controls.
using NewListView = test_support::MemoryNewList;
using ExportView = test_support::MemoryFormExport;

// A catalogue folder and an output folder, and the windows on them, every call going through
// `sys`.
class Rig {
  public:
    // A fresh folder holding the suggestion files and an empty index, and an output folder.
    Rig();
    // The windows over an existing catalogue folder, without an output folder: a child that
    // is killed leaves nothing of its own behind.
    explicit Rig(const std::string& folder);

    void put(const std::string& name, const std::string& bytes) const;
    void putList(const std::string& name, const std::string& entries, const std::string& articles,
                 const std::string& counter = "A#001\r\n",
                 const std::string& flag = " 1 \r\n") const;
    // Export settings for the output folder: every box clear, HTML when asked.
    void putExportSettings(bool html = false) const;
    // The main window's start-up.
    void start() { view.window.show(); }
    // The user selects a list, or an entry of the open list; false when it is not shown.
    bool open(const std::string& list) { return view.List_list.userSelect(list); }
    bool select(const std::string& title) { return view.List1.userSelect(title); }
    // The user clears the entry fields and types these values.
    void fill(const std::string& title, const std::string& type, const std::string& discs,
              const std::string& information);
    // The user opens the new-list dialog, types the name and presses "Create".
    void createList(const std::string& name);

    // The catalogue folder's files, and the output folder's under "out/"; the output folder's
    // path in them reads "<out>" (every rig has its own).
    Files files() const;
    // The message boxes titled "Error" shown so far.
    std::vector<ui::memory::MemoryPlatform::Shown> errors() const;

  private:
    std::unique_ptr<test_support::TempFolder> own_, ownOut_;

  public:
    std::string folder;
    std::string out;
    RelaySys sys;
    catalogue::Store store;
    ui::memory::MemoryPlatform platform;
    test_support::MemoryForm1 view;
    main_window::Form1 form;
    NewListView newListView;
    new_list::Form_new_list newList;
    ExportView exportView;
    exporting::Form_Export exporter;
};

// Entries as the entry file holds them: four tagged lines each, from title/type/discs/info rows.
std::string entryText(const std::vector<std::vector<std::string>>& rows);
// Lines, each followed by CR LF.
std::string crlf(const std::vector<std::string>& lines);

}  // namespace faults
