#include "catalogue/file_io.h"

#include <fcntl.h>
#include <unistd.h>

#include <cerrno>

#include "catalogue/catalogue_error.h"

namespace catalogue::file_io {

FileStamp stampFrom(const struct stat& st) {
    FileStamp stamp;
    stamp.exists = true;
    stamp.device = st.st_dev;
    stamp.inode = st.st_ino;
    stamp.size = st.st_size;
    stamp.modified = st.st_mtim;
    return stamp;
}

std::string readAll(Sys& sys, const std::string& fullPath, const std::string& shown,
                    FileStamp* stamp) {
    const int fd = sys.open(fullPath, O_RDONLY | O_NONBLOCK, 0);
    if (fd < 0) throw osError(shown, errno);
    struct stat st {};
    if (::fstat(fd, &st) != 0) {
        const int err = errno;
        sys.close(fd);
        throw osError(shown, err);
    }
    if (!S_ISREG(st.st_mode)) {
        sys.close(fd);
        if (S_ISDIR(st.st_mode)) throw osError(shown, EISDIR);
        throw CatalogueError(shown, "it is a FIFO or a device, not a file");
    }
    if (stamp != nullptr) *stamp = stampFrom(st);
    std::string bytes;
    // Room for a line past the end: adding an entry appends one to a file it has just read, and
    // a long list's file is then not moved to a bigger buffer.
    bytes.reserve(static_cast<size_t>(st.st_size) + 256);
    char buffer[65536];
    for (;;) {
        const ssize_t got = sys.read(fd, buffer, sizeof buffer);
        if (got < 0) {
            if (errno == EINTR) continue;
            const int err = errno;
            sys.close(fd);
            throw osError(shown, err);
        }
        if (got == 0) break;
        bytes.append(buffer, static_cast<size_t>(got));
    }
    sys.close(fd);
    return bytes;
}

std::string baseName(const std::string& path) {
    const std::size_t slash = path.rfind('/');
    return slash == std::string::npos ? path : path.substr(slash + 1);
}

std::string folderOf(const std::string& path) {
    const std::size_t slash = path.rfind('/');
    if (slash == std::string::npos) return ".";
    if (slash == 0) return "/";
    return path.substr(0, slash);
}

void writeAll(Sys& sys, const std::string& fullPath, const std::string& shown,
              std::string_view bytes, const mode_t* keepMode, bool durable, FileStamp* written) {
    const int fd = sys.open(fullPath, O_WRONLY | O_CREAT | O_TRUNC | O_NONBLOCK, 0666);
    if (fd < 0) throw osError(shown, errno);
    if (keepMode != nullptr) (void)::fchmod(fd, *keepMode);
    std::size_t done = 0;
    while (done < bytes.size()) {
        const ssize_t wrote = sys.write(fd, bytes.data() + done, bytes.size() - done);
        if (wrote < 0) {
            if (errno == EINTR) continue;
            const int err = errno;
            sys.close(fd);
            sys.unlink(fullPath);
            throw osError(shown, err);
        }
        done += static_cast<std::size_t>(wrote);
    }
    if (durable && sys.fsync(fd) != 0) {
        const int err = errno;
        sys.close(fd);
        sys.unlink(fullPath);
        throw osError(shown, err);
    }
    // Taken after the last write, so the stamp is the one the file keeps once it is in place.
    struct stat st {};
    if (written != nullptr && ::fstat(fd, &st) == 0) *written = stampFrom(st);
    if (sys.close(fd) != 0) {
        const int err = errno;
        sys.unlink(fullPath);
        throw osError(shown, err);
    }
}

void syncDirectory(Sys& sys, const std::string& folder, const std::string& shown) {
    const int fd = sys.open(folder, O_RDONLY | O_DIRECTORY, 0);
    if (fd < 0) throw osError(shown, errno);
    if (sys.fsync(fd) != 0) {
        const int err = errno;
        sys.close(fd);
        throw osError(shown, err);
    }
    sys.close(fd);
}

std::optional<mode_t> modeOf(const std::string& fullPath) {
    struct stat st {};
    if (::stat(fullPath.c_str(), &st) != 0 || !S_ISREG(st.st_mode)) return std::nullopt;
    return st.st_mode & 07777;
}

void refuseProtected(const std::string& fullPath, const std::string& shown) {
    struct stat st {};
    if (::stat(fullPath.c_str(), &st) == 0 && S_ISREG(st.st_mode) && (st.st_mode & 0222) == 0) {
        throw osError(shown, EACCES);
    }
}

void refuseUnreplaceable(const std::string& fullPath, const std::string& shown, bool replacing) {
    struct stat st {};
    if (::lstat(fullPath.c_str(), &st) != 0) {
        if (errno != ENOENT) throw osError(shown, errno);
        return;
    }
    if (S_ISDIR(st.st_mode)) throw osError(shown, EISDIR);
    // Nor is a FIFO or a device that the user put in a file's place replaced by a file.
    if (replacing && !S_ISREG(st.st_mode) && !S_ISLNK(st.st_mode)) {
        throw CatalogueError(shown, "it is a FIFO or a device, not a file");
    }
}

}  // namespace catalogue::file_io
