#pragma once

#include <algorithm>
#include <bit>
#include <cstdint>
#include <cstring>
#include <string_view>

#if defined(__SSE2__)
#include <emmintrin.h>
#endif
#if defined(__x86_64__) && !defined(__AVX__)
#include <immintrin.h>
#endif

// Finding a few given bytes in long texts sixteen (or eight) bytes at a time: the CSV reader and
// the import look at every byte of a file, and most bytes are none of the ones they stop at.
namespace catalogue {

#if defined(__x86_64__) && !defined(__AVX__)
[[gnu::target("avx")]] inline void zeroUpperVectorHalves() {
    _mm256_zeroupper();
}
#endif

// Clears the upper halves of the processor's AVX registers, where it has them. Library code run
// before (the toolkit's string routines, measured here) leaves data there, and while it stays
// every sixteen-byte instruction of a build without AVX waits to merge with it: the scans below
// then took two to four times as long. Called before a long run of them.
inline void clearUpperVectorHalves() {
#if defined(__x86_64__) && !defined(__AVX__)
    if (__builtin_cpu_supports("avx")) zeroUpperVectorHalves();
#endif
}

// The first position at or after `from` whose byte is one of `Stops`; the size when none is.
// Inlined: it is called once per field, and most fields are shorter than a few words.
template <unsigned char... Stops>
[[gnu::always_inline]] inline std::size_t findAnyOf(std::string_view text, std::size_t from = 0) {
    const char* const bytes = text.data();
    const std::size_t size = text.size();
#if defined(__SSE2__)
    for (; from + 16 <= size; from += 16) {
        const __m128i block = _mm_loadu_si128(reinterpret_cast<const __m128i*>(bytes + from));
        __m128i hits = _mm_setzero_si128();
        ((hits =
              _mm_or_si128(hits, _mm_cmpeq_epi8(block, _mm_set1_epi8(static_cast<char>(Stops))))),
         ...);
        if (const int mask = _mm_movemask_epi8(hits); mask != 0) {
            return from + static_cast<std::size_t>(std::countr_zero(static_cast<unsigned>(mask)));
        }
    }
#endif
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

// How many bytes of text[from, to) are `byte`.
template <unsigned char Byte>
inline std::size_t countOf(std::string_view text, std::size_t from, std::size_t to) {
    const char* const bytes = text.data();
    std::size_t count = 0;
#if defined(__SSE2__)
    // Each of sixteen byte counters takes up to 255 blocks; their sums are then added up. (A
    // count of mask bits would call a library routine on processors without a popcount.)
    const __m128i byte = _mm_set1_epi8(static_cast<char>(Byte));
    while (from + 16 <= to) {
        __m128i counters = _mm_setzero_si128();
        const std::size_t blocks = std::min<std::size_t>((to - from) / 16, 255);
        for (std::size_t b = 0; b < blocks; ++b, from += 16) {
            const __m128i block = _mm_loadu_si128(reinterpret_cast<const __m128i*>(bytes + from));
            counters = _mm_sub_epi8(counters, _mm_cmpeq_epi8(block, byte));
        }
        const __m128i sums = _mm_sad_epu8(counters, _mm_setzero_si128());
        count += static_cast<std::size_t>(_mm_cvtsi128_si32(sums)) +
                 static_cast<std::size_t>(_mm_extract_epi16(sums, 4));
    }
#endif
    for (; from < to; ++from) count += static_cast<unsigned char>(bytes[from]) == Byte ? 1 : 0;
    return count;
}

// What a text holds of two kinds of byte: one of `Stops`, and one above 127.
struct ByteKinds {
    bool stop = false;
    bool high = false;
};

template <unsigned char... Stops>
inline ByteKinds byteKinds(std::string_view text) {
    static_assert(((Stops != 0) && ...), "short texts are padded with zero bytes");
    const char* const bytes = text.data();
    const std::size_t size = text.size();
    std::size_t from = 0;
    ByteKinds kinds;
#if defined(__SSE2__)
    int stops = 0, high = 0;
    auto look = [&](const char* at) {
        const __m128i block = _mm_loadu_si128(reinterpret_cast<const __m128i*>(at));
        __m128i hits = _mm_setzero_si128();
        ((hits =
              _mm_or_si128(hits, _mm_cmpeq_epi8(block, _mm_set1_epi8(static_cast<char>(Stops))))),
         ...);
        stops |= _mm_movemask_epi8(hits);
        high |= _mm_movemask_epi8(block);
    };
    for (; from + 16 <= size; from += 16) look(bytes + from);
    if (from < size) {
        if (size >= 16) {
            look(bytes + size - 16);  // the last sixteen bytes, some of them looked at already
        } else {
            char padded[16] = {};  // zero bytes are neither stops nor above 127
            std::memcpy(padded, bytes, size);
            look(padded);
        }
        from = size;
    }
    kinds = {stops != 0, high != 0};
#endif
    for (; from < size; ++from) {
        const auto c = static_cast<unsigned char>(bytes[from]);
        kinds.stop = kinds.stop || ((c == Stops) || ...);
        kinds.high = kinds.high || c > 127;
    }
    return kinds;
}

}  // namespace catalogue
