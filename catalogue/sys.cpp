#include "catalogue/sys.h"

#include <fcntl.h>
#include <stdio.h>
#include <unistd.h>

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

}  // namespace catalogue
