#pragma once

#include <algorithm>
#include <array>
#include <cstdint>
#include <cstring>
#include <string>
#include <string_view>
#include <vector>

#include "catalogue/latin1.h"

// The titles an import has seen, ignoring letter case: those of the list it adds to and those of
// the rows taken in so far.
namespace catalogue::import_titles {

// The titles of a list folded, each kept once in one text and found through open addressing,
// so that a title costs no allocation of its own. A slot is eight bytes (part of the hash, and
// which title), so the table of a full list stays in the processor's cache.
class TitleSet {
  public:
    // Room for `expected` titles without growing.
    void reserve(std::size_t expected) {
        std::size_t size = 1024;
        while (size < expected * 2) size *= 2;
        if (size > slots_.size()) rehash(size);
    }

    // Folds `title` and fetches its place in the table, which holds() then looks at: the fetch
    // goes on while the caller does other work.
    void look(std::string_view title) {
        if (slots_.empty()) rehash(1024);
        const std::size_t used = starts_.back();
        // Bytes past the last title are spare room for the next.
        if (keys_.size() < used + title.size() + 8) {
            keys_.resize(std::max(keys_.size() * 2, used + title.size() + 4096));
        }
        char* const key = keys_.data() + used;
        for (std::size_t i = 0; i < title.size(); ++i) {
            key[i] =
                static_cast<char>(list_order::kFoldTable[static_cast<unsigned char>(title[i])]);
        }
        length_ = title.size();
        tag_ = hashOf(key, length_);
        __builtin_prefetch(&slots_[tag_ & (slots_.size() - 1)]);
    }

    // Whether the set holds the title last given to look(), ignoring case. When it does not,
    // add() takes it in.
    bool holds() {
        const char* const key = keys_.data() + starts_.back();
        const std::size_t mask = slots_.size() - 1;
        for (slot_ = tag_ & mask; slots_[slot_] != 0; slot_ = (slot_ + 1) & mask) {
            const std::uint64_t s = slots_[slot_];
            if (s >> 32 != tag_) continue;
            const std::size_t other = (s & 0xFFFFFFFFu) - 1;
            const std::size_t start = starts_[other];
            if (starts_[other + 1] - start == length_ &&
                std::memcmp(keys_.data() + start, key, length_) == 0) {
                return true;
            }
        }
        return false;
    }

    // Takes in the title that holds() last looked for and did not find.
    void add() {
        // Titles are counted in 32 bits: a list's files would need far more memory than there
        // is to hold 2^32 of them.
        slots_[slot_] = std::uint64_t{tag_} << 32 | static_cast<std::uint32_t>(starts_.size());
        starts_.push_back(starts_.back() + length_);
        if (starts_.size() * 2 > slots_.size()) rehash(slots_.size() * 2);
    }

  private:
    // Mixes a folded title in eight bytes at a time. The eight bytes after the title must be
    // readable: look() keeps them spare.
    static std::uint32_t hashOf(const char* key, std::size_t length) {
        std::uint64_t h = 0x9E3779B97F4A7C15u ^ length;
        std::size_t i = 0;
        for (; i + 8 <= length; i += 8) {
            std::uint64_t word;
            std::memcpy(&word, key + i, 8);
            h = (h ^ word) * 0xBF58476D1CE4E5B9u;
            h ^= h >> 29;
        }
        std::uint64_t last;
        std::memcpy(&last, key + i, 8);
        const std::size_t rest = length - i;  // 0 to 7 bytes of the title, the rest spare
        last = rest == 0 ? 0 : last & (~std::uint64_t{0} >> (64 - 8 * rest));
        h = (h ^ last) * 0x94D049BB133111EBu;
        return static_cast<std::uint32_t>(h ^ h >> 32);
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

    std::string keys_;  // the folded titles one after another, the one looked for, spare room
    std::vector<std::size_t> starts_ = {0};  // where each title starts in keys_, and the end
    std::vector<std::uint64_t> slots_;       // hash << 32 | title + 1; 0 when free
    std::size_t slot_ = 0, length_ = 0;      // the title last looked for
    std::uint32_t tag_ = 0;
};

}  // namespace catalogue::import_titles
