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
};

std::string encodeJournal(const JournalPlan& plan);

// The plan of a complete journal; nothing when the bytes are incomplete or damaged.
std::optional<JournalPlan> decodeJournal(std::string_view bytes);

}  // namespace catalogue
