#include "catalogue/sys.h"

#include <fcntl.h>
#include <stdio.h>
#include <sys/mman.h>
#include <unistd.h>

#include <cstdint>

namespace catalogue {

int Sys::open(const std::string& path, int flags, mode_t mode) {
    return ::open(path.c_str(), flags | O_CLOEXEC, mode);
}
ssize_t Sys::read(int fd, void* buffer, size_t size) {
    return ::read(fd, buffer, size);
}
ssize_t Sys::write(int fd, const void* buffer, size_t size) {
    return ::write(fd, buffer, size);
}
int Sys::fsync(int fd) {
    return ::fsync(fd);
}
int Sys::close(int fd) {
    return ::close(fd);
}
int Sys::rename(const std::string& from, const std::string& to) {
    return ::rename(from.c_str(), to.c_str());
}
int Sys::unlink(const std::string& path) {
    return ::unlink(path.c_str());
}

Sys& realSys() {
    static Sys sys;
    return sys;
}

void backMemory(void* start, std::size_t size) {
#if defined(MADV_POPULATE_WRITE)
    const long page = ::sysconf(_SC_PAGESIZE);
    if (page <= 0) return;
    const auto mask = static_cast<std::uintptr_t>(page) - 1;
    const std::uintptr_t first = (reinterpret_cast<std::uintptr_t>(start) + mask) & ~mask;
    const std::uintptr_t end = (reinterpret_cast<std::uintptr_t>(start) + size) & ~mask;
    // Only a hint: a refusal leaves the pages to come as they are written.
    if (end > first)
        (void)::madvise(reinterpret_cast<void*>(first), end - first, MADV_POPULATE_WRITE);
#else
    (void)start;
    (void)size;
#endif
}

void reserveBacked(std::string& text, std::size_t size) {
    text.reserve(size);
    backMemory(text.data() + text.size(), text.capacity() - text.size());
}

}  // namespace catalogue
