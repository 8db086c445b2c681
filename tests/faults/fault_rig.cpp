#include "tests/faults/fault_rig.h"

#include <fcntl.h>
#include <signal.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <iostream>
#include <sstream>

namespace faults {

namespace fs = std::filesystem;
using test_support::SysCall;

Files snapshot(const std::string& folder, const std::string& prefix) {
    Files files;
    for (const auto& item : fs::directory_iterator(folder)) {
        const std::string name = prefix + item.path().filename().string();
        const fs::file_status status = item.symlink_status();
        if (fs::is_symlink(status)) {
            files[name] = "[link to " + fs::read_symlink(item.path()).string() + "]";
        } else if (fs::is_directory(status)) {
            files[name] = "[folder]";
        } else {
            std::ifstream in(item.path(), std::ios::binary);
            std::ostringstream bytes;
            bytes << in.rdbuf();
            files[name] = bytes.str();
        }
    }
    return files;
}

std::string difference(const Files& a, const Files& b) {
    std::string out;
    for (const auto& [name, bytes] : a) {
        const auto other = b.find(name);
        if (other == b.end()) {
            out += " only-first:" + name;
        } else if (other->second != bytes) {
            out += " differs:" + name;
        }
    }
    for (const auto& [name, bytes] : b) {
        if (!a.contains(name)) out += " only-second:" + name;
    }
    return out.empty() ? " none" : out;
}

std::vector<std::string> leftovers(const Files& files) {
    std::vector<std::string> names;
    for (const auto& [name, bytes] : files) {
        if (name.ends_with(catalogue::kTempSuffix) || name == catalogue::kJournalName) {
            names.push_back(name);
        }
    }
    return names;
}

void RelaySys::use(catalogue::Sys& sys, const test_support::FaultySys* watched) {
    target_ = &sys;
    watched_ = watched;
    hit_.reset();
}

std::pair<std::string, bool> RelaySys::fileOf(int fd) const {
    const auto at = fds_.find(fd);
    return at == fds_.end() ? std::pair<std::string, bool>() : at->second;
}

template <class Call>
auto RelaySys::pass(SysCall kind, const std::string& path, bool reading, Call call) {
    if (killAt_ > 0 && ++steps_ == killAt_) ::raise(SIGKILL);
    const auto result = call();
    // The caller reads errno right after the call.
    const int err = errno;
    if (watched_ != nullptr && watched_->fired() && !hit_) hit_ = Hit{kind, path, reading};
    errno = err;
    return result;
}

int RelaySys::open(const std::string& path, int flags, mode_t mode) {
    const bool reading = (flags & O_ACCMODE) == O_RDONLY && (flags & O_DIRECTORY) == 0;
    const int fd =
        pass(SysCall::Open, path, reading, [&] { return target_->open(path, flags, mode); });
    if (fd >= 0) fds_[fd] = {path, reading};
    return fd;
}
ssize_t RelaySys::read(int fd, void* buffer, size_t size) {
    return pass(SysCall::Read, fileOf(fd).first, true,
                [&] { return target_->read(fd, buffer, size); });
}
ssize_t RelaySys::write(int fd, const void* buffer, size_t size) {
    return pass(SysCall::Write, fileOf(fd).first, false,
                [&] { return target_->write(fd, buffer, size); });
}
int RelaySys::fsync(int fd) {
    return pass(SysCall::Fsync, fileOf(fd).first, false, [&] { return target_->fsync(fd); });
}
int RelaySys::close(int fd) {
    const auto [path, reading] = fileOf(fd);
    fds_.erase(fd);
    return pass(SysCall::Close, path, reading, [&] { return target_->close(fd); });
}
int RelaySys::rename(const std::string& from, const std::string& to) {
    return pass(SysCall::Rename, to, false, [&] { return target_->rename(from, to); });
}
int RelaySys::unlink(const std::string& path) {
    return pass(SysCall::Unlink, path, false, [&] { return target_->unlink(path); });
}

int inChild(const std::function<void()>& body, int killAfterMs) {
    std::cout.flush();
    std::cerr.flush();
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

std::string describeStatus(int status) {
    if (status == -1) return "fork failed";
    if (WIFSIGNALED(status)) return "killed by signal " + std::to_string(WTERMSIG(status));
    return "exit " + std::to_string(WEXITSTATUS(status));
}

Rig::Rig() : Rig(std::string()) {}

Rig::Rig(const std::string& existing)
    : own_(existing.empty() ? std::make_unique<test_support::TempFolder>() : nullptr),
      ownOut_(existing.empty() ? std::make_unique<test_support::TempFolder>() : nullptr),
      folder(existing.empty() ? own_->path() : existing),
      out(existing.empty() ? ownOut_->path() : std::string()),
      store(folder, sys),
      form(view.controls(), platform, store),
      newList({newListView.window, newListView.Label1, newListView.Text1, newListView.Check_info,
               newListView.Command1, newListView.Command2},
              platform, store, form),
      exporter(exportView.controls(), platform, store, form) {
    if (own_) {
        put("type.dat", "Types\r\nMusic CD\r\nDVD video\r\nGame\r\n");
        put("information.dat", "Information\r\nOriginal\r\nCopy\r\n");
        put("pemla.dat", "");
    }
    form.setDialogs({&newListView.window, &exportView.window, nullptr});
}

void Rig::put(const std::string& name, const std::string& bytes) const {
    std::ofstream out(folder + "/" + name, std::ios::binary | std::ios::trunc);
    out.write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
    if (!out) throw std::runtime_error("cannot write test file " + name);
}

void Rig::putList(const std::string& name, const std::string& entries, const std::string& articles,
                  const std::string& counter, const std::string& flag) const {
    put(name + ".dat", entries);
    put(name + ".art", articles);
    put(name + ".arn", counter);
    if (!flag.empty()) put(name + ".inf", flag);
}

void Rig::putExportSettings(bool html) const {
    put("export.dat", crlf({out, "0", html ? "1" : "0", "0", "0", "0", "0", "10", "Top"}));
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

void Rig::fill(const std::string& title, const std::string& type, const std::string& discs,
               const std::string& information) {
    view.Text1.type(std::string(view.Text1.text().size(), '\b') + title);
    view.Combo1.type(std::string(view.Combo1.text().size(), '\b') + type);
    view.Combo2.type(std::string(view.Combo2.text().size(), '\b') + discs);
    view.Combo3.type(std::string(view.Combo3.text().size(), '\b') + information);
}

void Rig::createList(const std::string& name) {
    view.Command_create.click();
    newListView.Text1.type(name);
    newListView.Command1.click();
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
