#include "list_order/list_order.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>

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

void sortItems(std::vector<std::string>& items) {
    // Every item folded once into one buffer; the sort then compares plain bytes, and mostly
    // only the first eight of them, held next to the item's number.
    std::size_t total = 0;
    for (const auto& item : items) total += item.size();
    std::string folded;
    folded.reserve(total);
    std::vector<std::size_t> starts(items.size() + 1);
    for (std::size_t i = 0; i < items.size(); ++i) {
        starts[i] = folded.size();
        for (char c : items[i])
            folded.push_back(static_cast<char>(foldByte(static_cast<unsigned char>(c))));
    }
    starts[items.size()] = folded.size();
    const auto key = [&](std::size_t i) {
        return std::string_view(folded).substr(starts[i], starts[i + 1] - starts[i]);
    };
    struct Head {
        std::uint64_t bytes;  // the first eight folded bytes, the first one highest; zeros after
        std::size_t item;
    };
    std::vector<Head> heads(items.size());
    for (std::size_t i = 0; i < items.size(); ++i) {
        const std::string_view k = key(i);
        std::uint64_t bytes = 0;
        for (std::size_t b = 0; b < 8; ++b) {
            bytes = bytes << 8 | (b < k.size() ? static_cast<unsigned char>(k[b]) : 0u);
        }
        heads[i] = {bytes, i};
    }
    // Heads that differ order the items as their folded texts do (unsigned bytes, a shorter
    // prefix first); equal heads leave it to the whole texts, then to the items themselves.
    std::sort(heads.begin(), heads.end(), [&](const Head& a, const Head& b) {
        if (a.bytes != b.bytes) return a.bytes < b.bytes;
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
