#pragma once

#include <array>
#include <cstddef>
#include <set>

#include "catalogue/sys.h"

namespace test_support {

// The kinds of system call a test can count and make fail.
enum class SysCall { Open, Read, Write, Fsync, Close, Rename, Unlink };
inline constexpr std::array kAllSysCalls = {SysCall::Open,  SysCall::Read,  SysCall::Write,
                                            SysCall::Fsync, SysCall::Close, SysCall::Rename,
                                            SysCall::Unlink};
const char* sysCallName(SysCall kind);

// Thrown by FaultySys to stop an operation dead, as if the process had been killed there.
// Deliberately not a CatalogueError, so no handler in the store can take it for a failure.
struct CrashStop {};

// The real system calls with one planned fault: the n-th call of a kind fails with an errno,
// or the n-th call of any kind throws CrashStop (and every call after it, since a killed
// process makes no more calls). Counts every call.
class FaultySys : public catalogue::Sys {
  public:
    ~FaultySys() override;

    // The n-th call (counting from 1) of `kind` fails with `errnum` without taking effect, and
    // so do the `times` - 1 calls of that kind after it.
    void failAt(SysCall kind, int n, int errnum, int times = 1);
    // The n-th call of any kind throws CrashStop; the process's open files are closed then.
    void crashAt(int step);
    // Writes move at most `bytes` bytes per call, as a pipe or a full disk may do.
    void capWrites(std::size_t bytes) { writeCap_ = bytes; }

    int calls(SysCall kind) const { return counts_[static_cast<std::size_t>(kind)]; }
    int steps() const { return steps_; }
    // Whether the planned fault or crash has happened.
    bool fired() const { return fired_; }

    int open(const std::string& path, int flags, mode_t mode) override;
    ssize_t read(int fd, void* buffer, size_t size) override;
    ssize_t write(int fd, const void* buffer, size_t size) override;
    int fsync(int fd) override;
    int close(int fd) override;
    int rename(const std::string& from, const std::string& to) override;
    int unlink(const std::string& path) override;

  private:
    // Counts the call; true when it is the one to fail (errno is then set).
    bool fault(SysCall kind);

    std::array<int, kAllSysCalls.size()> counts_{};
    int steps_ = 0;
    SysCall failKind_ = SysCall::Open;
    int failAt_ = 0;
    int failTimes_ = 1;
    int failErrno_ = 0;
    int crashAt_ = 0;
    bool fired_ = false;
    bool dead_ = false;
    std::size_t writeCap_ = 0;
    std::set<int> openFds_;
};

}  // namespace test_support
