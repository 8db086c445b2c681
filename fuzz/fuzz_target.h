// What every fuzz target shares: libFuzzer's entry point hands the input to `fuzzOne` as bytes,
// and a broken rule ends the run through `check`, so libFuzzer keeps the input that broke it.
#pragma once

#include <cstdlib>
#include <string>

// Defined once per target: runs the target's reader on `bytes` and checks its rules.
void fuzzOne(const std::string& bytes);

inline void check(bool holds) {
    if (!holds) std::abort();
}
