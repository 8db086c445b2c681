#pragma once

#include <cstdint>
#include <cstring>
#include <optional>
#include <string_view>
#include <vector>

#include "catalogue/sys.h"

// Lookups of many titles in one entry text or article text, each text indexed once, so that a
// report of the largest list costs linear time. They find what the catalogue's one-title lookups
// find on the same texts.
namespace exporting {

// A hash of a title ignoring Latin-1 case, eight bytes at a time: titles that are equal, or
// equal ignoring case, hash alike, so one hash serves the exact and the folded lookups. Every
// byte is taken with its 0x20 bit set, which is where a capital and its small letter differ;
// the few other bytes that then hash alike ("@" and "`", say) are told apart by the lookups.
inline std::size_t titleHash(std::string_view text) {
    const char* const bytes = text.data();
    const std::size_t size = text.size();
    std::uint64_t h = 0x9E3779B97F4A7C15ull ^ size;
    const auto mix = [&h](std::uint64_t word) {
        h = (h ^ (word | 0x2020202020202020ull)) * 0xFF51AFD7ED558CCDull;
        h ^= h >> 32;
    };
    const auto load = [bytes](std::size_t at, auto word) {
        std::memcpy(&word, bytes + at, sizeof word);
        return static_cast<std::uint64_t>(word);
    };
    if (size >= 8) {
        for (std::size_t at = 0; at + 8 < size; at += 8) mix(load(at, std::uint64_t{}));
        mix(load(size - 8, std::uint64_t{}));  // the last eight, some of them mixed in already
    } else if (size >= 4) {
        mix(load(0, std::uint32_t{}) | load(size - 4, std::uint32_t{}) << 32);
    } else if (size > 0) {
        mix(load(0, std::uint8_t{}) | load(size / 2, std::uint8_t{}) << 8 |
            load(size - 1, std::uint8_t{}) << 16);
    } else {
        mix(0);
    }
    return static_cast<std::size_t>(h);
}

// Where the titles of one text stand, found by title through open addressing and kept in
// nothing but the table: a slot is eight bytes, part of the title's hash and the title's place
// in the text, and the title is compared where it stands. A full list's table then takes half a
// megabyte, which the report fetches a few rows ahead. `Key` tells the title at a place and
// whether a title is the one there. The first place put in for a title stays.
template <typename Key>
class PlaceMap {
  public:
    static constexpr std::size_t npos = std::string_view::npos;

    PlaceMap(std::string_view text, std::size_t expected) : text_(text) {
        std::size_t size = 64;
        while (size < expected * 2) size *= 2;
        slots_.reserve(size);
        catalogue::backMemory(slots_.data(), size * sizeof(std::uint64_t));
        slots_.resize(size);
    }

    void putFirst(std::string_view title, std::size_t place) {
        const std::size_t hash = titleHash(title);
        std::size_t i = hash & (slots_.size() - 1);
        for (; slots_[i] != 0; i = (i + 1) & (slots_.size() - 1)) {
            if (matches(slots_[i], hash, title)) return;
        }
        slots_[i] = tagOf(hash) | (place + 1);
        if (++used_ * 2 > slots_.size()) grow();
    }

    // Fetches the slot of a title hashed `hash` into the cache, for a find() a little later.
    void prefetch(std::size_t hash) const {
        __builtin_prefetch(&slots_[hash & (slots_.size() - 1)]);
    }

    // The place of `title`, whose titleHash() is `hash`; npos when it has none.
    std::size_t find(std::string_view title, std::size_t hash) const {
        for (std::size_t i = hash & (slots_.size() - 1); slots_[i] != 0;
             i = (i + 1) & (slots_.size() - 1)) {
            if (matches(slots_[i], hash, title)) return (slots_[i] & kPlaces) - 1;
        }
        return npos;
    }

  private:
    // Places take the low 40 bits: a text of a terabyte would not fit in memory.
    static constexpr std::uint64_t kPlaces = (std::uint64_t{1} << 40) - 1;

    static std::uint64_t tagOf(std::size_t hash) { return hash & ~kPlaces; }
    bool matches(std::uint64_t slot, std::size_t hash, std::string_view title) const {
        return (slot & ~kPlaces) == tagOf(hash) && Key::holds(text_, (slot & kPlaces) - 1, title);
    }

    void grow() {
        std::vector<std::uint64_t> old(slots_.size() * 2);
        old.swap(slots_);
        for (const std::uint64_t slot : old) {
            if (slot == 0) continue;
            const std::size_t hash = titleHash(Key::at(text_, (slot & kPlaces) - 1));
            std::size_t i = hash & (slots_.size() - 1);
            while (slots_[i] != 0) i = (i + 1) & (slots_.size() - 1);
            slots_[i] = slot;
        }
    }

    std::string_view text_;
    std::vector<std::uint64_t> slots_;  // hash's high bits, then place + 1; 0 when free
    std::size_t used_ = 0;
};

// Whether two titles are the same, compared eight bytes at a time in place: a lookup compares
// one title of some twenty bytes, too few to be worth a call.
inline bool sameTitle(std::string_view a, std::string_view b) {
    const std::size_t size = a.size();
    if (b.size() != size) return false;
    if (size < 8) return size == 0 || std::memcmp(a.data(), b.data(), size) == 0;
    const auto differ = [&](std::size_t at) {
        std::uint64_t x, y;
        std::memcpy(&x, a.data() + at, 8);
        std::memcpy(&y, b.data() + at, 8);
        return x != y;
    };
    for (std::size_t at = 0; at + 8 < size; at += 8) {
        if (differ(at)) return false;
    }
    return !differ(size - 8);
}

// Whether `text` holds "&", "<" or ">".
bool needsEscapes(std::string_view text);

// The three fields of an entry besides its title, as views into the entry text.
struct Fields {
    std::string_view type;
    std::string_view discs;
    std::string_view information;
};

// Every title line of an entry text, looked up by its exact title; the first one wins, as a
// search from the start of the text would find it. The other fields follow from the first of
// their markers after the title, which in a file the program wrote start the next lines.
class EntryIndex {
  public:
    // `expected`: about how many titles the text holds (the table grows past it).
    EntryIndex(std::string_view text, std::size_t expected);

    // Fetches the slot of a title hashed `hash` (its titleHash()) into the cache.
    void prefetch(std::size_t hash) const { titles_.prefetch(hash); }

    Fields find(std::string_view title) const { return find(title, titleHash(title)); }
    Fields find(std::string_view title, std::size_t hash) const;

  private:
    // A title stands after its marker, up to the line's CR.
    struct TitleKey {
        static std::string_view at(std::string_view text, std::size_t marker);
        static bool holds(std::string_view text, std::size_t marker, std::string_view title) {
            const std::size_t start = marker + 3;
            return text.size() - start > title.size() && text[start + title.size()] == '\r' &&
                   sameTitle(text.substr(start, title.size()), title);
        }
    };

    bool indexPlainEntries();
    void indexMarkedTitles();
    Fields plainFields(std::size_t typeLine) const;
    std::string_view fieldAfter(std::string_view tag, std::size_t kind, std::size_t& from) const;
    const std::vector<std::size_t>& markers(std::size_t kind, std::string_view tag) const;

    std::string_view text_;
    bool plain_ = false;  // the text holds plain entries only
    PlaceMap<TitleKey> titles_;
    mutable std::optional<std::vector<std::size_t>> markers_[3];  // type, discs, info
};

// Every article line of an article text by its title ignoring case; the first line wins. A line
// is "title#*\number"; each "#*\" of a line could end the title, as the line-by-line search of
// the catalogue would allow.
class ArticleIndex {
  public:
    // `expected`: about how many lines the text holds (the table grows past it).
    ArticleIndex(std::string_view text, std::size_t expected);

    // Fetches the slot of a title hashed `hash` (its titleHash()) into the cache.
    void prefetch(std::size_t hash) const { numbers_.prefetch(hash); }

    std::string_view find(std::string_view title) const { return find(title, titleHash(title)); }
    std::string_view find(std::string_view title, std::size_t hash) const;

  private:
    // A title is the start of a line up to a separator on that line.
    struct LineKey {
        static std::string_view at(std::string_view text, std::size_t separator);
        static bool holds(std::string_view text, std::size_t separator, std::string_view title);
    };

    std::string_view text_;
    PlaceMap<LineKey> numbers_;
};

}  // namespace exporting
