#pragma once

#include <cstdint>
#include <cstring>
#include <optional>
#include <string_view>
#include <vector>

#include "catalogue/latin1.h"

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

// Titles to values found through open addressing, hashed by titleHash(): built once per report,
// it costs no allocation per title. A slot is eight bytes (part of the hash, and which record),
// so the table of a full list stays in the processor's cache. The first value put in for a
// title stays.
template <typename Value, bool (*Equal)(std::string_view, std::string_view)>
class FlatTitleMap {
  public:
    explicit FlatTitleMap(std::size_t expected) {
        std::size_t size = 64;
        while (size < expected * 2) size *= 2;
        slots_.resize(size);
        records_.reserve(expected);
    }

    void putFirst(std::string_view title, const Value& value) {
        const std::size_t hash = titleHash(title);
        std::size_t i = hash & (slots_.size() - 1);
        for (; slots_[i] != 0; i = (i + 1) & (slots_.size() - 1)) {
            if (matches(slots_[i], hash, title)) return;
        }
        // Records are counted in 32 bits: a text holding 2^32 titles would not fit in memory.
        records_.push_back({title, value});
        slots_[i] = tagOf(hash) | records_.size();
        if (records_.size() * 2 > slots_.size()) grow();
    }

    // Fetches the slot of a title hashed `hash` into the cache, for a find() a little later.
    void prefetch(std::size_t hash) const {
        __builtin_prefetch(&slots_[hash & (slots_.size() - 1)]);
    }

    // The value of `title`, whose titleHash() is `hash`; nothing when it has none.
    const Value* find(std::string_view title, std::size_t hash) const {
        for (std::size_t i = hash & (slots_.size() - 1); slots_[i] != 0;
             i = (i + 1) & (slots_.size() - 1)) {
            if (matches(slots_[i], hash, title))
                return &records_[(slots_[i] & 0xFFFFFFFFu) - 1].value;
        }
        return nullptr;
    }

  private:
    struct Record {
        std::string_view title;
        Value value;
    };

    static std::uint64_t tagOf(std::size_t hash) {
        return static_cast<std::uint64_t>(hash) >> 32 << 32;
    }
    bool matches(std::uint64_t slot, std::size_t hash, std::string_view title) const {
        return (slot >> 32 << 32) == tagOf(hash) &&
               Equal(records_[(slot & 0xFFFFFFFFu) - 1].title, title);
    }

    void grow() {
        std::vector<std::uint64_t> old(slots_.size() * 2);
        old.swap(slots_);
        for (const std::uint64_t slot : old) {
            if (slot == 0) continue;
            const std::size_t hash = titleHash(records_[(slot & 0xFFFFFFFFu) - 1].title);
            std::size_t i = hash & (slots_.size() - 1);
            while (slots_[i] != 0) i = (i + 1) & (slots_.size() - 1);
            slots_[i] = slot;
        }
    }

    std::vector<std::uint64_t> slots_;  // hash's high half, then record + 1; 0 when free
    std::vector<Record> records_;
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
// The same, or the same ignoring Latin-1 case.
inline bool sameTitleIgnoringCase(std::string_view a, std::string_view b) {
    return sameTitle(a, b) || (a.size() == b.size() && catalogue::equalsIgnoreCase(a, b));
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

    // Fetches what find() needs of a title hashed `hash` (its titleHash()) into the cache.
    void prefetch(std::size_t hash) const { titles_.prefetch(hash); }

    Fields find(std::string_view title) const { return find(title, titleHash(title)); }
    Fields find(std::string_view title, std::size_t hash) const {
        const Fields* hit = titles_.find(title, hash);
        return hit == nullptr ? Fields() : *hit;
    }

  private:
    bool indexPlainEntries();
    void indexMarkedTitles();
    std::string_view fieldAfter(std::string_view tag, std::size_t kind, std::size_t& from) const;
    const std::vector<std::size_t>& markers(std::size_t kind, std::string_view tag) const;

    std::string_view text_;
    FlatTitleMap<Fields, sameTitle> titles_;
    mutable std::optional<std::vector<std::size_t>> markers_[3];  // type, discs, info
};

// Every article line of an article text by its title ignoring case; the first line wins. A line
// is "title#*\number"; each "#*\" of a line could end the title, as the line-by-line search of
// the catalogue would allow.
class ArticleIndex {
  public:
    // `expected`: about how many lines the text holds (the table grows past it).
    ArticleIndex(std::string_view text, std::size_t expected);

    // Fetches what find() needs of a title hashed `hash` (its titleHash()) into the cache.
    void prefetch(std::size_t hash) const { numbers_.prefetch(hash); }

    std::string_view find(std::string_view title) const { return find(title, titleHash(title)); }
    std::string_view find(std::string_view title, std::size_t hash) const {
        const std::string_view* hit = numbers_.find(title, hash);
        return hit == nullptr ? std::string_view() : *hit;
    }

  private:
    FlatTitleMap<std::string_view, sameTitleIgnoringCase> numbers_;
};

}  // namespace exporting
