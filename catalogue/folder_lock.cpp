#include "catalogue/folder_lock.h"

#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>

namespace catalogue {

FolderLock::FolderLock(const std::string& folder) {
    std::string path = folder.empty() ? std::string(".") : folder;
    if (!path.ends_with('/')) path.push_back('/');
    path.append(kLockName);
    // The lock file stays empty and is never written: it only carries the lock. Opening it
    // without blocking keeps a FIFO of that name from stalling the start.
    fd_ = ::open(path.c_str(), O_RDWR | O_CREAT | O_NONBLOCK | O_CLOEXEC, 0666);
    if (fd_ < 0) return;
    struct stat st {};
    if (::fstat(fd_, &st) != 0 || !S_ISREG(st.st_mode)) {
        ::close(fd_);
        fd_ = -1;
        return;
    }
    int result;
    while ((result = ::flock(fd_, LOCK_EX | LOCK_NB)) != 0 && errno == EINTR) {
    }
    if (result == 0) {
        state_ = State::Held;
        return;
    }
    if (errno == EWOULDBLOCK) state_ = State::Taken;
    ::close(fd_);
    fd_ = -1;
}

FolderLock::~FolderLock() {
    if (fd_ >= 0) ::close(fd_);
}

}  // namespace catalogue
