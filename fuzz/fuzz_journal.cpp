// Any bytes as a commit journal: only a complete, intact journal is ever acted on.
#include "catalogue/journal.h"
#include "fuzz/fuzz_target.h"

void fuzzOne(const std::string& bytes) {
    const auto plan = catalogue::decodeJournal(bytes);
    if (!plan) return;
    for (const auto& [staged, target] : plan->renames) {
        check(staged.find('/') == std::string::npos && target.find('/') == std::string::npos);
    }
    for (const auto& stray : plan->strays) check(catalogue::isStrayPath(stray));
    check(catalogue::encodeJournal(*plan) == bytes);
}
