#include "tests/support/faulty_sys.h"

#include <fcntl.h>
#include <signal.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <cstdio>

namespace test_support {

const char* sysCallName(SysCall kind) {
    static const char* const names[] = {"open",  "read",   "write", "fsync",
                                        "close", "rename", "unlink"};
    return names[static_cast<std::size_t>(kind)];
}

FaultySys::~FaultySys() {
    for (const auto& item : openFiles_) ::close(item.first);
}

bool FaultySys::fault(SysCall kind, const Hit& file) {
    if (killStep_ > 0 && steps_ + 1 == killStep_) ::raise(SIGKILL);
    ++steps_;
    const int count = ++counts_[static_cast<std::size_t>(kind)];
    const auto& p = planned_;
    if (p.at > 0 && kind == p.kind && count >= p.at && count < p.at + p.times) {
        if (!hit_) hit_ = file;
        errno = p.errnum;
        return true;
    }
    return false;
}

int FaultySys::open(const std::string& path, int flags, mode_t mode) {
    const Hit file{path, (flags & O_ACCMODE) == O_RDONLY && (flags & O_DIRECTORY) == 0};
    if (fault(SysCall::Open, file)) return -1;
    const int fd = Sys::open(path, flags, mode);
    if (fd >= 0) openFiles_[fd] = file;
    return fd;
}

ssize_t FaultySys::read(int fd, void* buffer, size_t size) {
    if (fault(SysCall::Read, {openFiles_[fd].path, true})) return -1;
    return Sys::read(fd, buffer, size);
}

ssize_t FaultySys::write(int fd, const void* buffer, size_t size) {
    if (fault(SysCall::Write, {openFiles_[fd].path, false})) return -1;
    return Sys::write(fd, buffer, writeCap_ > 0 ? std::min(size, writeCap_) : size);
}

int FaultySys::fsync(int fd) {
    if (fault(SysCall::Fsync, {openFiles_[fd].path, false})) return -1;
    return Sys::fsync(fd);
}

int FaultySys::close(int fd) {
    const bool failed = fault(SysCall::Close, openFiles_[fd]);
    openFiles_.erase(fd);
    if (failed) {
        // Linux frees the descriptor even when close reports an error.
        const int err = errno;
        ::close(fd);
        errno = err;
        return -1;
    }
    return Sys::close(fd);
}

int FaultySys::rename(const std::string& from, const std::string& to) {
    if (fault(SysCall::Rename, {to, false})) return -1;
    return Sys::rename(from, to);
}

int FaultySys::unlink(const std::string& path) {
    if (fault(SysCall::Unlink, {path, false})) return -1;
    return Sys::unlink(path);
}

int inChild(const std::function<void()>& body) {
    // Output is flushed first so that the child repeats none of it (std::cout writes to stdio).
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
    int status = 0;
    while (::waitpid(pid, &status, 0) < 0 && errno == EINTR) {
    }
    return status;
}

bool killed(int status) {
    return status != -1 && WIFSIGNALED(status) && WTERMSIG(status) == SIGKILL;
}

}  // namespace test_support
