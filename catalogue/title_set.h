#pragma once

#include <algorithm>
#include <cstdint>
#include <cstring>
#include <string_view>
#include <vector>

#if defined(__SSE2__)
#include <emmintrin.h>
#endif

#include "catalogue/latin1.h"

// The titles an import has seen, ignoring letter case: those of the list it adds to and those of
// the rows taken in so far.
namespace catalogue::import_titles {

// The titles of a list, found through open addressing on a hash of their folded bytes. The set
// keeps no copy of a title: it notes where the title stands in the list's entry text, which the
// caller keeps and hands in to compare. A slot is eight bytes (part of the hash, and which
// title), so the table of a full list stays in the processor's cache.
class TitleSet {
  public:
    // Room for `expected` titles without growing.
    void reserve(std::size_t expected) {
        std::size_t size = 1024;
        while (size < expected * 2) size *= 2;
        if (size > slots_.size()) rehash(size);
        places_.reserve(expected);
    }

    // Hashes `title` folded and fetches its place in the table, which holds() then looks at: the
    // fetch goes on while the caller does other work. `readAhead`: sixteen bytes from the
    // title's start may be read, however short it is. The title must stay until add().
    void look(std::string_view title, bool readAhead) {
        if (slots_.empty()) rehash(1024);
        title_ = title;
        tag_ = hashOf(title, readAhead);
        __builtin_prefetch(&slots_[tag_ & (slots_.size() - 1)]);
    }

    // Whether the set holds the title last given to look(), ignoring case; `text` is the one
    // the titles taken in stand in. When it does not, add() takes the title in.
    bool holds(std::string_view text) {
        const std::size_t mask = slots_.size() - 1;
        for (slot_ = tag_ & mask; slots_[slot_] != 0; slot_ = (slot_ + 1) & mask) {
            const std::uint64_t s = slots_[slot_];
            if (s >> 32 != tag_) continue;
            const Place& other = places_[(s & 0xFFFFFFFFu) - 1];
            if (equalsIgnoreCase(text.substr(other.at, other.size), title_)) return true;
        }
        return false;
    }

    // Takes in the title that holds() last looked for and did not find; it stands at `at` in
    // the text holds() is given.
    void add(std::size_t at) {
        // Titles are counted in 32 bits: a list's files would need far more memory than there
        // is to hold 2^32 of them.
        places_.push_back({at, title_.size()});
        slots_[slot_] = std::uint64_t{tag_} << 32 | static_cast<std::uint32_t>(places_.size());
        if (places_.size() * 2 > slots_.size()) rehash(slots_.size() * 2);
    }

  private:
    struct Place {
        std::size_t at, size;
    };

    // Folds sixteen bytes as foldByte() does (A-Z and the accented capitals 0xC0-0xDE except
    // 0xD7 get 0x20 added), keeping the first `keep` of them and clearing the others.
    static void fold16(const char* from, std::size_t keep, unsigned char (&to)[16]) {
#if defined(__SSE2__)
        static constexpr unsigned char kKeep[32] = {0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF,
                                                    0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF};
        const __m128i v = _mm_loadu_si128(reinterpret_cast<const __m128i*>(from));
        // Shifted so that each range starts at -128, where one signed comparison bounds it.
        const __m128i latin =
            _mm_cmplt_epi8(_mm_sub_epi8(v, _mm_set1_epi8(0x40)), _mm_set1_epi8(-128 + 31));
        const __m128i ascii =
            _mm_cmplt_epi8(_mm_add_epi8(v, _mm_set1_epi8(static_cast<char>(0x80 - 'A'))),
                           _mm_set1_epi8(-128 + 26));
        const __m128i times = _mm_cmpeq_epi8(v, _mm_set1_epi8(static_cast<char>(0xD7)));
        const __m128i upper = _mm_andnot_si128(times, _mm_or_si128(latin, ascii));
        const __m128i folded = _mm_add_epi8(v, _mm_and_si128(upper, _mm_set1_epi8(0x20)));
        const __m128i kept = _mm_loadu_si128(reinterpret_cast<const __m128i*>(kKeep + 16 - keep));
        _mm_storeu_si128(reinterpret_cast<__m128i*>(to), _mm_and_si128(folded, kept));
#else
        for (std::size_t i = 0; i < 16; ++i) {
            to[i] = i < keep ? list_order::kFoldTable[static_cast<unsigned char>(from[i])] : 0;
        }
#endif
    }

    // Mixes a title in folded, sixteen bytes at a time; the last sixteen of a longer title
    // overlap the block before them, a shorter one is padded with zero bytes.
    static std::uint32_t hashOf(std::string_view title, bool readAhead) {
        const char* const bytes = title.data();
        const std::size_t size = title.size();
        std::uint64_t h = 0x9E3779B97F4A7C15u ^ size;
        auto mix = [&h](const char* block, std::size_t keep) {
            unsigned char folded[16];
            fold16(block, keep, folded);
            std::uint64_t low, high;
            std::memcpy(&low, folded, 8);
            std::memcpy(&high, folded + 8, 8);
            h = (h ^ low) * 0xBF58476D1CE4E5B9u;
            h = (h ^ (h >> 29) ^ high) * 0x94D049BB133111EBu;
            h ^= h >> 32;
        };
        if (size >= 16) {
            for (std::size_t i = 0; i + 16 < size; i += 16) mix(bytes + i, 16);
            mix(bytes + size - 16, 16);
        } else if (size > 0 && readAhead) {
            mix(bytes, size);
        } else {
            char padded[16] = {};
            if (size > 0) std::memcpy(padded, bytes, size);
            mix(padded, size);
        }
        return static_cast<std::uint32_t>(h);
    }

    void rehash(std::size_t size) {
        std::vector<std::uint64_t> old(size);
        old.swap(slots_);
        const std::size_t mask = size - 1;
        for (const std::uint64_t s : old) {
            if (s == 0) continue;
            std::size_t i = (s >> 32) & mask;
            while (slots_[i] != 0) i = (i + 1) & mask;
            slots_[i] = s;
        }
    }

    std::vector<Place> places_;         // where each title taken in stands, and its size
    std::vector<std::uint64_t> slots_;  // hash << 32 | title + 1; 0 when free
    std::string_view title_;            // the title last looked for
    std::size_t slot_ = 0;
    std::uint32_t tag_ = 0;
};

}  // namespace catalogue::import_titles
