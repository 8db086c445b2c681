#pragma once

#include <algorithm>
#include <array>
#include <cstdint>
#include <cstring>
#include <functional>
#include <optional>
#include <string_view>
#include <vector>

#include "catalogue/file_text.h"
#include "catalogue/latin1.h"
#include "catalogue/records.h"

// Lookups of many titles in one entry text or article text, each text indexed once, so that a
// report of the largest list costs linear time. They find what the catalogue's one-title lookups
// find on the same texts.
namespace exporting {

// The three fields of an entry besides its title, as views into the entry text.
struct Fields {
    std::string_view type;
    std::string_view discs;
    std::string_view information;
};

// Titles to values found through open addressing: built once per report, it costs no
// allocation per title. A slot is eight bytes (part of the hash, and which record), so the table
// of a full list stays in the processor's cache. The first value put in for a title stays.
template <typename Value, typename Hash, typename Equal>
class FlatTitleMap {
  public:
    explicit FlatTitleMap(std::size_t expected) {
        std::size_t size = 64;
        while (size < expected * 2) size *= 2;
        slots_.resize(size);
        records_.reserve(expected);
    }

    void putFirst(std::string_view title, const Value& value) {
        const std::size_t hash = Hash{}(title);
        std::size_t i = hash & (slots_.size() - 1);
        for (; slots_[i] != 0; i = (i + 1) & (slots_.size() - 1)) {
            if (matches(slots_[i], hash, title)) return;
        }
        // Records are counted in 32 bits: a text holding 2^32 titles would not fit in memory.
        records_.push_back({title, value});
        slots_[i] = tagOf(hash) | records_.size();
        if (records_.size() * 2 > slots_.size()) grow();
    }

    // The hash of a title, its slot fetched into the cache meanwhile, for find().
    std::size_t prefetch(std::string_view title) const {
        const std::size_t hash = Hash{}(title);
        __builtin_prefetch(&slots_[hash & (slots_.size() - 1)]);
        return hash;
    }

    // The value of `title`, whose hash is `hash`; nothing when it has none.
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
               Equal{}(records_[(slot & 0xFFFFFFFFu) - 1].title, title);
    }

    void grow() {
        std::vector<std::uint64_t> old(slots_.size() * 2);
        old.swap(slots_);
        for (const std::uint64_t slot : old) {
            if (slot == 0) continue;
            const std::size_t hash = Hash{}(records_[(slot & 0xFFFFFFFFu) - 1].title);
            std::size_t i = hash & (slots_.size() - 1);
            while (slots_[i] != 0) i = (i + 1) & (slots_.size() - 1);
            slots_[i] = slot;
        }
    }

    std::vector<std::uint64_t> slots_;  // hash's high half, then record + 1; 0 when free
    std::vector<Record> records_;
};

// Every title line of an entry text, looked up by its exact title; the first one wins, as a
// search from the start of the text would find it. The other fields follow from the first of
// their markers after the title, which in a file the program wrote start the next lines.
class EntryIndex {
  public:
    explicit EntryIndex(std::string_view text) : text_(text) {
        for (std::size_t at = text.find(catalogue::kTitleTag); at != std::string_view::npos;
             at = text.find(catalogue::kTitleTag, at + 1)) {
            const std::size_t start = at + catalogue::kTitleTag.size();
            const std::size_t cr = text.find('\r', start);
            if (cr == std::string_view::npos) break;  // a title line needs its CR
            titles_.putFirst(text.substr(start, cr - start), at);
        }
    }

    // Starts looking for `title`: its hash, for find().
    std::size_t prefetch(std::string_view title) const { return titles_.prefetch(title); }

    Fields find(std::string_view title) const { return find(title, titles_.prefetch(title)); }
    Fields find(std::string_view title, std::size_t hash) const {
        const std::size_t* hit = titles_.find(title, hash);
        if (hit == nullptr) return {};
        std::size_t from = *hit + 1;  // past the title's own marker, which is none of the others
        Fields fields;
        fields.type = fieldAfter(catalogue::kTypeTag, 0, from);
        fields.discs = fieldAfter(catalogue::kDiscsTag, 1, from);
        fields.information = fieldAfter(catalogue::kInfoTag, 2, from);
        return fields;
    }

  private:
    // The text after the first `tag` at or after `from`, up to the next CR; `from` moves to that
    // CR. Empty when no such marker follows.
    std::string_view fieldAfter(std::string_view tag, std::size_t kind, std::size_t& from) const {
        // Every marker starts with "<": when the first "<" from here starts this one, it is the
        // first. Otherwise (a file written by hand) the marker's positions are searched.
        std::size_t at = text_.find('<', from);
        if (at == std::string_view::npos) return {};
        if (text_.compare(at, tag.size(), tag) != 0) {
            const std::vector<std::size_t>& positions = markers(kind, tag);
            const auto next = std::lower_bound(positions.begin(), positions.end(), from);
            if (next == positions.end()) return {};
            at = *next;
        }
        const std::size_t start = at + tag.size();
        std::size_t cr = text_.find('\r', start);
        if (cr == std::string_view::npos) cr = text_.size();
        from = cr;
        return text_.substr(start, cr - start);
    }

    // Where every `tag` stands in the text, found on first need.
    const std::vector<std::size_t>& markers(std::size_t kind, std::string_view tag) const {
        std::optional<std::vector<std::size_t>>& positions = markers_[kind];
        if (!positions) {
            positions.emplace();
            for (std::size_t at = text_.find(tag); at != std::string_view::npos;
                 at = text_.find(tag, at + 1)) {
                positions->push_back(at);
            }
        }
        return *positions;
    }

    std::string_view text_;
    // Entries of a real list take some 60 bytes or more; the map grows should they be shorter.
    FlatTitleMap<std::size_t, std::hash<std::string_view>, std::equal_to<>> titles_{
        text_.size() / 60 + 1};
    mutable std::array<std::optional<std::vector<std::size_t>>, 3> markers_;  // type, discs, info
};

// Hashing and comparing titles ignoring Latin-1 case, without building folded copies. The hash
// takes eight folded bytes at a time; eight ASCII bytes are folded at once.
struct FoldedHash {
    std::size_t operator()(std::string_view text) const {
        constexpr std::uint64_t kEach = 0x0101010101010101ull;
        std::uint64_t h = 0x9E3779B97F4A7C15ull ^ text.size();
        for (std::size_t at = 0; at < text.size(); at += 8) {
            std::uint64_t word = 0;
            const std::size_t n = std::min<std::size_t>(8, text.size() - at);
            if (n == 8) std::memcpy(&word, text.data() + at, 8);
            if (n == 8 && (word & kEach * 0x80) == 0) {
                // Bytes below 128 add without carrying into their neighbours: "A" and above
                // reach the high bit with 0x3F added, and above "Z" already with 0x25.
                const std::uint64_t capitals = (word + kEach * 0x3F) & ~(word + kEach * 0x25);
                word |= (capitals & kEach * 0x80) >> 2;
            } else {
                word = 0;
                for (std::size_t b = 0; b < n; ++b) {
                    word |=
                        std::uint64_t{
                            list_order::kFoldTable[static_cast<unsigned char>(text[at + b])]}
                        << (8 * b);
                }
            }
            h = (h ^ word) * 0xFF51AFD7ED558CCDull;
            h ^= h >> 32;
        }
        return static_cast<std::size_t>(h);
    }
};
struct FoldedEqual {
    bool operator()(std::string_view a, std::string_view b) const {
        return catalogue::equalsIgnoreCase(a, b);
    }
};

// Every article line of an article text by its title ignoring case; the first line wins. A line
// is "title#*\number"; each "#*\" of a line could end the title, as the line-by-line search of
// the catalogue would allow.
class ArticleIndex {
  public:
    explicit ArticleIndex(std::string_view text) : numbers_(text.size() / 30 + 1) {
        std::size_t start = 0;
        while (start < text.size()) {
            const auto [line, end] = catalogue::lineAt(text, start);
            for (std::size_t at = line.find(catalogue::kArticleSeparator);
                 at != std::string_view::npos;
                 at = line.find(catalogue::kArticleSeparator, at + 1)) {
                const std::size_t numberAt = at + catalogue::kArticleSeparator.size();
                if (start + numberAt >= end) break;  // nothing at all follows the separator
                numbers_.putFirst(line.substr(0, at), line.substr(numberAt, 4));
            }
            start = end;
        }
    }

    // Starts looking for `title`: its hash, for find().
    std::size_t prefetch(std::string_view title) const { return numbers_.prefetch(title); }

    std::string_view find(std::string_view title) const {
        return find(title, numbers_.prefetch(title));
    }
    std::string_view find(std::string_view title, std::size_t hash) const {
        const std::string_view* hit = numbers_.find(title, hash);
        return hit == nullptr ? std::string_view() : *hit;
    }

  private:
    // Article lines of a real list take some 30 bytes; the map grows should they be shorter.
    FlatTitleMap<std::string_view, FoldedHash, FoldedEqual> numbers_;
};

}  // namespace exporting
