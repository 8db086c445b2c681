#include "fuzz/fuzz_target.h"

#include <cstdint>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    fuzzOne(std::string(reinterpret_cast<const char*>(data), size));
    return 0;
}
