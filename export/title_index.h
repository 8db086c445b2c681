#pragma once

#include <algorithm>
#include <string_view>
#include <unordered_map>
#include <vector>

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

// Every title line of an entry text, looked up by its exact title; the first one wins, as a
// search from the start of the text would find it. The other fields are found by the positions
// of their markers, so a title costs a few binary searches however long the text is.
class EntryIndex {
  public:
    explicit EntryIndex(std::string_view text) : text_(text) {
        // An entry takes at least twenty bytes; reserving for that many avoids rehashing.
        titles_.reserve(text.size() / 20 + 1);
        for (std::size_t at = text.find(catalogue::kTitleTag); at != std::string_view::npos;
             at = text.find(catalogue::kTitleTag, at + 1)) {
            const std::size_t start = at + catalogue::kTitleTag.size();
            const std::size_t cr = text.find('\r', start);
            if (cr == std::string_view::npos) break;  // a title line needs its CR
            titles_.emplace(text.substr(start, cr - start), at);
        }
        collect(catalogue::kTypeTag, types_);
        collect(catalogue::kDiscsTag, discs_);
        collect(catalogue::kInfoTag, infos_);
    }

    Fields find(std::string_view title) const {
        const auto hit = titles_.find(title);
        if (hit == titles_.end()) return {};
        std::size_t from = hit->second;
        Fields fields;
        fields.type = fieldAfter(types_, from);
        fields.discs = fieldAfter(discs_, from);
        fields.information = fieldAfter(infos_, from);
        return fields;
    }

  private:
    void collect(std::string_view tag, std::vector<std::size_t>& positions) const {
        for (std::size_t at = text_.find(tag); at != std::string_view::npos;
             at = text_.find(tag, at + 1)) {
            positions.push_back(at);
        }
    }

    // The text after the first marker at or after `from`, up to the next CR; `from` moves to
    // that CR. Empty when no marker follows.
    std::string_view fieldAfter(const std::vector<std::size_t>& positions,
                                std::size_t& from) const {
        const auto at = std::lower_bound(positions.begin(), positions.end(), from);
        if (at == positions.end()) return {};
        const std::size_t start = *at + 3;
        std::size_t cr = text_.find('\r', start);
        if (cr == std::string_view::npos) cr = text_.size();
        from = cr;
        return text_.substr(start, cr - start);
    }

    std::string_view text_;
    std::unordered_map<std::string_view, std::size_t> titles_;
    std::vector<std::size_t> types_;
    std::vector<std::size_t> discs_;
    std::vector<std::size_t> infos_;
};

// Hashing and comparing titles ignoring Latin-1 case, without building folded copies.
struct FoldedHash {
    std::size_t operator()(std::string_view text) const {
        std::size_t h = 14695981039346656037ull;
        for (char c : text) {
            h = (h ^ catalogue::foldByte(static_cast<unsigned char>(c))) * 1099511628211ull;
        }
        return h;
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
    explicit ArticleIndex(std::string_view text) {
        numbers_.reserve(text.size() / 9 + 1);  // an article line takes at least nine bytes
        std::size_t start = 0;
        while (start < text.size()) {
            std::size_t cr = text.find('\r', start);
            std::size_t end = cr == std::string_view::npos ? text.size() : cr + 1;
            if (cr == std::string_view::npos) cr = text.size();
            if (end < text.size() && text[end] == '\n') ++end;
            const std::string_view line = text.substr(start, cr - start);
            for (std::size_t at = line.find(catalogue::kArticleSeparator);
                 at != std::string_view::npos;
                 at = line.find(catalogue::kArticleSeparator, at + 1)) {
                const std::size_t numberAt = at + catalogue::kArticleSeparator.size();
                if (start + numberAt >= end) break;  // nothing at all follows the separator
                numbers_.emplace(line.substr(0, at), line.substr(numberAt, 4));
            }
            start = end;
        }
    }

    std::string_view find(std::string_view title) const {
        const auto hit = numbers_.find(title);
        return hit == numbers_.end() ? std::string_view() : hit->second;
    }

  private:
    std::unordered_map<std::string_view, std::string_view, FoldedHash, FoldedEqual> numbers_;
};

}  // namespace exporting
