#pragma once

#include <sys/types.h>

#include <string>

// The operating-system calls the store makes, behind one seam so that tests can make any single
// call fail, or stop the process at any step.
namespace catalogue {

class Sys {
  public:
    virtual ~Sys() = default;

    virtual int open(const std::string& path, int flags, mode_t mode);
    virtual ssize_t read(int fd, void* buffer, size_t size);
    virtual ssize_t write(int fd, const void* buffer, size_t size);
    virtual int fsync(int fd);
    virtual int close(int fd);
    virtual int rename(const std::string& from, const std::string& to);
    virtual int unlink(const std::string& path);
};

// The real calls.
Sys& realSys();

}  // namespace catalogue
