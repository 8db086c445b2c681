#include "tests/support/faulty_sys.h"

#include <unistd.h>

#include <algorithm>
#include <cerrno>

namespace test_support {

const char* sysCallName(SysCall kind) {
    switch (kind) {
        case SysCall::Open:
            return "open";
        case SysCall::Read:
            return "read";
        case SysCall::Write:
            return "write";
        case SysCall::Fsync:
            return "fsync";
        case SysCall::Close:
            return "close";
        case SysCall::Rename:
            return "rename";
        case SysCall::Unlink:
            return "unlink";
    }
    return "?";
}

FaultySys::~FaultySys() {
    for (int fd : openFds_) ::close(fd);
}

void FaultySys::failAt(SysCall kind, int n, int errnum, int times) {
    failKind_ = kind;
    failAt_ = n;
    failTimes_ = times;
    failErrno_ = errnum;
}

void FaultySys::crashAt(int step) {
    crashAt_ = step;
}

bool FaultySys::fault(SysCall kind) {
    if (dead_) throw CrashStop{};
    ++steps_;
    const int count = ++counts_[static_cast<std::size_t>(kind)];
    if (crashAt_ > 0 && steps_ == crashAt_) {
        // The kernel closes a killed process's files; nothing else of it runs.
        for (int fd : openFds_) ::close(fd);
        openFds_.clear();
        dead_ = fired_ = true;
        throw CrashStop{};
    }
    if (failAt_ > 0 && kind == failKind_ && count >= failAt_ && count < failAt_ + failTimes_) {
        fired_ = true;
        errno = failErrno_;
        return true;
    }
    return false;
}

int FaultySys::open(const std::string& path, int flags, mode_t mode) {
    if (fault(SysCall::Open)) return -1;
    const int fd = Sys::open(path, flags, mode);
    if (fd >= 0) openFds_.insert(fd);
    return fd;
}

ssize_t FaultySys::read(int fd, void* buffer, size_t size) {
    if (fault(SysCall::Read)) return -1;
    return Sys::read(fd, buffer, size);
}

ssize_t FaultySys::write(int fd, const void* buffer, size_t size) {
    if (fault(SysCall::Write)) return -1;
    return Sys::write(fd, buffer, writeCap_ > 0 ? std::min(size, writeCap_) : size);
}

int FaultySys::fsync(int fd) {
    if (fault(SysCall::Fsync)) return -1;
    return Sys::fsync(fd);
}

int FaultySys::close(int fd) {
    if (fault(SysCall::Close)) {
        // Linux frees the descriptor even when close reports an error.
        const int err = errno;
        ::close(fd);
        openFds_.erase(fd);
        errno = err;
        return -1;
    }
    openFds_.erase(fd);
    return Sys::close(fd);
}

int FaultySys::rename(const std::string& from, const std::string& to) {
    if (fault(SysCall::Rename)) return -1;
    return Sys::rename(from, to);
}

int FaultySys::unlink(const std::string& path) {
    if (fault(SysCall::Unlink)) return -1;
    return Sys::unlink(path);
}

}  // namespace test_support
