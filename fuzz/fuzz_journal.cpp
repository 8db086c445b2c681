// Any bytes as a commit journal: only a complete, intact journal is ever acted on.
#include <cstdint>
#include <cstdlib>
#include <string>

#include "catalogue/journal.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string bytes(reinterpret_cast<const char*>(data), size);
    if (const auto plan = catalogue::decodeJournal(bytes)) {
        for (const auto& [staged, target] : plan->renames) {
            if (staged.find('/') != std::string::npos || target.find('/') != std::string::npos) {
                std::abort();
            }
        }
        for (const auto& stray : plan->strays) {
            if (!catalogue::isStrayPath(stray)) std::abort();
        }
        if (catalogue::encodeJournal(*plan) != bytes) std::abort();
    }
    return 0;
}
