#include "list_order/list_order.h"

#include <algorithm>
#include <array>
#include <bit>
#include <cstddef>
#include <cstdint>
#include <cstring>

namespace list_order {

bool itemLess(std::string_view a, std::string_view b) {
    const std::size_t n = std::min(a.size(), b.size());
    for (std::size_t i = 0; i < n; ++i) {
        const unsigned char fa = foldByte(static_cast<unsigned char>(a[i]));
        const unsigned char fb = foldByte(static_cast<unsigned char>(b[i]));
        if (fa != fb) return fa < fb;
    }
    if (a.size() != b.size()) return a.size() < b.size();
    return a < b;
}

namespace {

// Bytes `from` to `from` + 7 of a folded text as one number, the first byte highest and zeros
// past the text's end. Eight bytes are read from `from` on, past the end too: the caller keeps
// them readable.
std::uint64_t headPart(std::string_view text, std::size_t from) {
    if (from >= text.size()) return 0;
    const std::size_t length = std::min<std::size_t>(8, text.size() - from);
    if constexpr (std::endian::native == std::endian::little) {
        std::uint64_t word;
        std::memcpy(&word, text.data() + from, 8);
        if (length < 8) word &= ~std::uint64_t{0} >> (64 - 8 * length);
        return __builtin_bswap64(word);
    }
    std::uint64_t word = 0;
    for (std::size_t b = 0; b < 8; ++b) {
        word = word << 8 | (b < length ? static_cast<unsigned char>(text[from + b]) : 0u);
    }
    return word;
}

}  // namespace

void sortItems(std::vector<std::string>& items) {
    // Every item folded once into one buffer; the sort then compares plain bytes, and mostly
    // only the first sixteen of them, held next to the item's number.
    std::size_t total = 0;
    for (const auto& item : items) total += item.size();
    std::string folded(total + 16, '\0');  // sixteen bytes spare: each head is read whole
    std::vector<std::size_t> starts(items.size() + 1);
    char* to = folded.data();
    for (std::size_t i = 0; i < items.size(); ++i) {
        starts[i] = static_cast<std::size_t>(to - folded.data());
        for (const char c : items[i])
            *to++ = static_cast<char>(kFoldTable[static_cast<unsigned char>(c)]);
    }
    starts[items.size()] = total;
    const auto key = [&](std::size_t i) {
        return std::string_view(folded).substr(starts[i], starts[i + 1] - starts[i]);
    };
    struct Head {
        // The first sixteen folded bytes, the first one highest; zeros after the text.
        std::uint64_t high, low;
        std::size_t item;
    };
    std::vector<Head> heads(items.size());
    for (std::size_t i = 0; i < items.size(); ++i) {
        const std::string_view k = key(i);
        heads[i] = {headPart(k, 0), headPart(k, 8), i};
    }
    // Heads that differ order the items as their folded texts do (unsigned bytes, a shorter
    // prefix first); equal heads leave it to the whole texts, then to the items themselves.
    std::sort(heads.begin(), heads.end(), [&](const Head& a, const Head& b) {
        if (a.high != b.high) return a.high < b.high;
        if (a.low != b.low) return a.low < b.low;
        const int byFold = key(a.item).compare(key(b.item));
        if (byFold != 0) return byFold < 0;
        return items[a.item] < items[b.item];
    });
    std::vector<std::string> sorted;
    sorted.reserve(items.size());
    for (const Head& h : heads) sorted.push_back(std::move(items[h.item]));
    items = std::move(sorted);
}

}  // namespace list_order
