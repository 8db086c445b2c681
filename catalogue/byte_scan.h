#pragma once

#include <bit>
#include <cstdint>
#include <cstring>
#include <string_view>

// Finding a few given bytes in long texts eight bytes at a time: the CSV reader and the import
// look at every byte of a file, and most bytes are none of the ones they stop at.
namespace catalogue {

// The first position at or after `from` whose byte is one of `Stops`; the size when none is.
// Inlined: it is called once per field, and most fields are shorter than a few words.
template <unsigned char... Stops>
[[gnu::always_inline]] inline std::size_t findAnyOf(std::string_view text, std::size_t from = 0) {
    const char* const bytes = text.data();
    const std::size_t size = text.size();
    if constexpr (std::endian::native == std::endian::little) {
        constexpr std::uint64_t kOnes = 0x0101010101010101u;
        constexpr std::uint64_t kHigh = 0x8080808080808080u;
        // A high bit set for each byte of `v` that is zero; the lowest one is exact (a borrow
        // may only mark bytes above a zero byte).
        auto zeroBytes = [](std::uint64_t v) { return (v - kOnes) & ~v & kHigh; };
        for (; from + 8 <= size; from += 8) {
            std::uint64_t word;
            std::memcpy(&word, bytes + from, 8);
            const std::uint64_t hits = (zeroBytes(word ^ (kOnes * Stops)) | ...);
            if (hits != 0) return from + static_cast<std::size_t>(std::countr_zero(hits)) / 8;
        }
    }
    for (; from < size; ++from) {
        const auto c = static_cast<unsigned char>(bytes[from]);
        if (((c == Stops) || ...)) return from;
    }
    return size;
}

}  // namespace catalogue
