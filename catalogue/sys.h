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

// Has the system back the whole pages of [start, start + size) with memory at once. Fresh memory
// is otherwise backed a page at a time, one fault for each 4 KB as it is first written: in a
// report of 5 MB that took 1.5 ms, and the single call a fraction of it. Where the system cannot
// (before Linux 5.14), the pages still come as they are written.
void backMemory(void* start, std::size_t size);

// Reserves room for `size` bytes in `text`, backed at once.
void reserveBacked(std::string& text, std::size_t size);

}  // namespace catalogue
