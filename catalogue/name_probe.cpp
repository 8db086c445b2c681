#include "catalogue/name_probe.h"

#include <fcntl.h>

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
    const std::string probe = store.path(fileSystemName(name) + std::string(kProbeSuffix));
    Sys& sys = store.sys();
    // Exclusive creation: a file of that name that the user already has is left as it is, and
    // its presence is itself proof that the name is accepted.
    const int fd = sys.open(probe, O_WRONLY | O_CREAT | O_EXCL, 0666);
    if (fd < 0) return errno == EEXIST;
    const bool closed = sys.close(fd) == 0;
    const bool removed = sys.unlink(probe) == 0;
    return closed && removed;
}

}  // namespace catalogue
