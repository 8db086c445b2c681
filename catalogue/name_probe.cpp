#include "catalogue/name_probe.h"

#include <fcntl.h>
#include <sys/stat.h>

#include <cerrno>
#include <string>

#include "catalogue/file_names.h"

namespace catalogue {

bool isPortableName(std::string_view name) {
    if (name == "." || name == "..") return false;
    for (const char ch : name) {
        const auto c = static_cast<unsigned char>(ch);
        if (c < 0x20 || (c >= 0x7F && c <= 0x9F)) return false;
        if (std::string_view("/\\:?*<>\"|").find(ch) != std::string_view::npos) return false;
    }
    return true;
}

bool probeFileName(Store& store, std::string_view name) {
    if (!isPortableName(name)) return false;
    const std::string probeName = fileSystemName(name) + std::string(kProbeSuffix);
    const std::string probe = store.path(probeName);
    // A file of that name that the user already has is left as it is, and its presence is
    // itself proof that the name is accepted. It is never recorded, so no start removes it.
    struct stat st {};
    if (::lstat(probe.c_str(), &st) == 0) return true;
    store.recordStrays({probeName});
    Sys& sys = store.sys();
    const int fd = sys.open(probe, O_WRONLY | O_CREAT | O_EXCL | O_NONBLOCK, 0666);
    if (fd < 0) {
        const bool theirs = errno == EEXIST;
        store.clearStrays();
        return theirs;
    }
    const bool closed = sys.close(fd) == 0;
    // A probe that stays would be taken for the user's own file next time: tried twice, and
    // should it still stay, its record stays too and the next start removes it.
    const bool removed = sys.unlink(probe) == 0 || sys.unlink(probe) == 0;
    if (removed) store.clearStrays();
    return closed && removed;
}

}  // namespace catalogue
