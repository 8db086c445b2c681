#pragma once

#include <array>
#include <cstddef>
#include <functional>
#include <map>
#include <optional>
#include <string>

#include "catalogue/sys.h"

namespace test_support {

// The kinds of system call a test can count and make fail.
enum class SysCall { Open, Read, Write, Fsync, Close, Rename, Unlink };
inline constexpr std::array kAllSysCalls = {SysCall::Open,  SysCall::Read,  SysCall::Write,
                                            SysCall::Fsync, SysCall::Close, SysCall::Rename,
                                            SysCall::Unlink};
const char* sysCallName(SysCall kind);

// The real system calls with one planned fault: the n-th call of a kind fails with an errno, or
// the process is killed with SIGKILL before the n-th call of any kind. Counts every call and
// remembers the file the fault hit.
class FaultySys : public catalogue::Sys {
  public:
    struct Hit {
        std::string path;
        bool reading;  // an open for reading, a read, or the close of a file opened for reading
    };
    ~FaultySys() override;

    // The n-th call of `kind` from now on (counting from 1) fails with `errnum` without taking
    // effect, and so do the `times` - 1 calls of that kind after it.
    void failNext(SysCall kind, int n, int errnum, int times = 1) {
        planned_ = {kind, calls(kind) + n, errnum, times};
    }
    // The n-th call of any kind from now on kills the process before it is made.
    void killAt(int n) { killStep_ = steps_ + n; }
    // Writes move at most `bytes` bytes per call, as a pipe or a full disk may do.
    void capWrites(std::size_t bytes) { writeCap_ = bytes; }

    int calls(SysCall kind) const { return counts_[static_cast<std::size_t>(kind)]; }
    // Whether the planned fault has happened, and on which file.
    bool fired() const { return hit_.has_value(); }
    const std::optional<Hit>& hit() const { return hit_; }

    int open(const std::string& path, int flags, mode_t mode) override;
    ssize_t read(int fd, void* buffer, size_t size) override;
    ssize_t write(int fd, const void* buffer, size_t size) override;
    int fsync(int fd) override;
    int close(int fd) override;
    int rename(const std::string& from, const std::string& to) override;
    int unlink(const std::string& path) override;

  private:
    // Counts the call; true when it is the one to fail (errno is then set).
    bool fault(SysCall kind, const Hit& file);

    std::array<int, kAllSysCalls.size()> counts_{};
    int steps_ = 0;
    struct {
        SysCall kind = SysCall::Open;
        int at = 0, errnum = 0, times = 1;
    } planned_;
    int killStep_ = 0;
    std::size_t writeCap_ = 0;
    std::optional<Hit> hit_;
    std::map<int, Hit> openFiles_;
};

// Runs `body` in a forked child that ends with _exit(0) when it returns and _exit(100) when it
// throws; returns the wait status.
int inChild(const std::function<void()>& body);
// Whether the wait status is that of a process killed with SIGKILL.
bool killed(int status);

}  // namespace test_support
