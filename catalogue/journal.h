#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

// The commit journal: which staged files replace which targets, and which files go. It is only
// acted on when it is complete; a torn or garbled journal reads as nothing.
namespace catalogue {

struct JournalPlan {
    std::vector<std::pair<std::string, std::string>> renames;  // staged name -> target name
    std::vector<std::string> deletions;
    // Short-lived files to remove if they are still there: a name probe of the folder, or a
    // report's staged copy given by its full path. Only names ending in ".del" or the staging
    // suffix are accepted, and a failure to remove one is no error.
    std::vector<std::string> strays;
};

std::string encodeJournal(const JournalPlan& plan);

// Whether `path` may be recorded as a stray: a plain name ending in ".del", or an absolute path
// whose last part ends in the staging suffix.
bool isStrayPath(std::string_view path);

// The plan of a complete journal; nothing when the bytes are incomplete or damaged.
std::optional<JournalPlan> decodeJournal(std::string_view bytes);

}  // namespace catalogue
