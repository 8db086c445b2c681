#pragma once

#include <sys/stat.h>

#include <optional>
#include <string>
#include <string_view>

#include "catalogue/store.h"
#include "catalogue/sys.h"

// The file-system steps the store and its transactions are made of. Every failure throws
// CatalogueError naming `shown` (the file as the user knows it) and the OS reason.
namespace catalogue::file_io {

// The staged copy of the journal, renamed into place once it is whole.
inline const std::string kJournalTemp = std::string(kJournalName) + std::string(kTempSuffix);

FileStamp stampFrom(const struct stat& st);

// Reads a whole regular file through `sys`; errors name `shown`. The descriptor is opened without
// blocking and checked before the first read, so a FIFO or a device never stalls the program.
std::string readAll(Sys& sys, const std::string& fullPath, const std::string& shown,
                    FileStamp* stamp = nullptr);

std::string baseName(const std::string& path);
std::string folderOf(const std::string& path);

// Writes a staged file. `keepMode` gives it the permission bits of the file it will replace; a
// file system that keeps no such bits may refuse them, which is no error. Without `durable` the
// data is not flushed: for records that only a killed process needs.
void writeAll(Sys& sys, const std::string& fullPath, const std::string& shown,
              std::string_view bytes, const mode_t* keepMode = nullptr, bool durable = true);

void syncDirectory(Sys& sys, const std::string& folder, const std::string& shown);

// The permission bits of a regular file about to be replaced, to give its successor.
std::optional<mode_t> modeOf(const std::string& fullPath);

// A file with every write permission bit cleared is one the user protected: it is neither
// replaced nor deleted, even where the process could (as root, or by renaming over it).
void refuseProtected(const std::string& fullPath, const std::string& shown);

// A target that the rename or unlink after the commit point would fail on (a folder, a name the
// system refuses) could never be finished by any recovery: it is refused while nothing changed.
void refuseUnreplaceable(const std::string& fullPath, const std::string& shown, bool replacing);

}  // namespace catalogue::file_io
