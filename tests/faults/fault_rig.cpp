#include "tests/faults/fault_rig.h"

#include <fcntl.h>
#include <signal.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <iostream>
#include <sstream>

#include "catalogue/folder_lock.h"

namespace faults {

namespace fs = std::filesystem;
using test_support::FaultySys;

Files snapshot(const std::string& folder, const std::string& prefix) {
    Files files;
    for (const auto& item : fs::directory_iterator(folder)) {
        // The running program's lock file is empty and carries no data.
        if (item.path().filename() == catalogue::kLockName) continue;
        std::string& bytes = files[prefix + item.path().filename().string()];
        if (fs::is_symlink(item.symlink_status())) {
            bytes = "[link to " + fs::read_symlink(item.path()).string() + "]";
        } else if (fs::is_directory(item.symlink_status())) {
            bytes = "[folder]";
        } else if (fs::is_fifo(item.symlink_status())) {
            bytes = "[fifo]";
        } else {
            std::ostringstream in;
            in << std::ifstream(item.path(), std::ios::binary).rdbuf();
            bytes = in.str();
        }
    }
    return files;
}

std::string difference(const Files& a, const Files& b) {
    std::string out;
    for (const auto& [name, bytes] : a) {
        if (!b.contains(name) || b.at(name) != bytes) out += " " + name;
    }
    for (const auto& item : b) out += a.contains(item.first) ? "" : " +" + item.first;
    return out;
}

bool hasLeftovers(const Files& files) {
    return std::any_of(files.begin(), files.end(), [](const auto& item) {
        return item.first.ends_with(catalogue::kTempSuffix) ||
               item.first == catalogue::kJournalName;
    });
}

template <class Call>
auto RigSys::pass(const Hit& file, Call call) {
    if (killStep_ > 0 && steps() + 1 == killStep_) ::raise(SIGKILL);
    const bool before = fired();
    const auto result = call();
    // The caller reads errno right after the call.
    const int err = errno;
    if (fired() && !before) hit_ = file;
    errno = err;
    return result;
}

int RigSys::open(const std::string& path, int flags, mode_t mode) {
    const bool reading = (flags & O_ACCMODE) == O_RDONLY && (flags & O_DIRECTORY) == 0;
    const int fd = pass({path, reading}, [&] { return FaultySys::open(path, flags, mode); });
    if (fd >= 0) files_[fd] = {path, reading};
    return fd;
}
ssize_t RigSys::read(int fd, void* buffer, size_t size) {
    return pass({files_[fd].path, true}, [&] { return FaultySys::read(fd, buffer, size); });
}
ssize_t RigSys::write(int fd, const void* buffer, size_t size) {
    return pass({files_[fd].path, false}, [&] { return FaultySys::write(fd, buffer, size); });
}
int RigSys::fsync(int fd) {
    return pass({files_[fd].path, false}, [&] { return FaultySys::fsync(fd); });
}
int RigSys::close(int fd) {
    const int result = pass(files_[fd], [&] { return FaultySys::close(fd); });
    files_.erase(fd);
    return result;
}
int RigSys::rename(const std::string& from, const std::string& to) {
    return pass({to, false}, [&] { return FaultySys::rename(from, to); });
}
int RigSys::unlink(const std::string& path) {
    return pass({path, false}, [&] { return FaultySys::unlink(path); });
}

int inChild(const std::function<void()>& body, int killAfterMs) {
    // Output is flushed first so that the child repeats none of it.
    std::cout.flush();
    std::fflush(nullptr);
    const pid_t pid = ::fork();
    if (pid < 0) return -1;
    if (pid == 0) {
        try {
            body();
        } catch (...) {
            ::_exit(100);
        }
        ::_exit(0);
    }
    if (killAfterMs >= 0) {
        ::usleep(static_cast<useconds_t>(killAfterMs) * 1000);
        ::kill(pid, SIGKILL);
    }
    int status = 0;
    while (::waitpid(pid, &status, 0) < 0 && errno == EINTR) {
    }
    return status;
}

bool killed(int status) {
    return status != -1 && WIFSIGNALED(status) && WTERMSIG(status) == SIGKILL;
}

Rig::Rig(const std::string& existing)
    : own_(existing.empty() ? std::make_unique<test_support::TempFolder>() : nullptr),
      ownOut_(existing.empty() ? std::make_unique<test_support::TempFolder>() : nullptr),
      folder(existing.empty() ? own_->path() : existing),
      out(existing.empty() ? ownOut_->path() : std::string()),
      store(folder, sys),
      form(view.controls(), platform, store),
      newList(newListView.controls(), platform, store, form),
      exporter(exportView.controls(), platform, store, form) {
    if (own_) {
        put("type.dat", "Types\r\nMusic CD\r\nDVD video\r\nGame\r\n");
        put("information.dat", "Information\r\nOriginal\r\nCopy\r\n");
        put("pemla.dat", "");
    }
    form.setDialogs({&newListView.window, &exportView.window, nullptr});
}

void Rig::put(const std::string& name, const std::string& bytes) const {
    if (!(std::ofstream(folder + "/" + name, std::ios::binary) << bytes)) {
        throw std::runtime_error("cannot write test file " + name);
    }
}

void Rig::fill(const std::string& title, const std::string& type, const std::string& discs,
               const std::string& information) {
    view.Text1.type(std::string(view.Text1.text().size(), '\b') + title);
    view.Combo1.type(std::string(view.Combo1.text().size(), '\b') + type);
    view.Combo2.type(std::string(view.Combo2.text().size(), '\b') + discs);
    view.Combo3.type(std::string(view.Combo3.text().size(), '\b') + information);
}

Files Rig::files() const {
    Files files = snapshot(folder);
    if (out.empty()) return files;
    files.merge(snapshot(out, "out/"));
    for (auto& [name, bytes] : files) {
        for (std::size_t at; (at = bytes.find(out)) != std::string::npos;) {
            bytes.replace(at, out.size(), "<out>");
        }
    }
    return files;
}

std::vector<ui::memory::MemoryPlatform::Shown> Rig::errors() const {
    std::vector<ui::memory::MemoryPlatform::Shown> shown;
    for (const auto& box : platform.shown()) {
        if (box.title == "Error") shown.push_back(box);
    }
    return shown;
}

std::string entryText(const std::vector<std::vector<std::string>>& rows) {
    std::string text;
    for (const auto& row : rows) {
        text += "<|?" + row.at(0) + "\r\n<|'" + row.at(1) + "\r\n<||" + row.at(2) + "\r\n<|*" +
                row.at(3) + "\r\n";
    }
    return text;
}

std::string crlf(const std::vector<std::string>& lines) {
    std::string text;
    for (const auto& line : lines) text += line + "\r\n";
    return text;
}

}  // namespace faults
