#include "list_order/list_order.h"

#include <algorithm>
#include <cstddef>

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
    // Every item folded once into one buffer; the sort then compares plain bytes.
    std::size_t total = 0;
    for (const auto& item : items) total += item.size();
    std::string folded;
    folded.reserve(total);
    std::vector<std::string_view> keys(items.size());
    std::vector<std::size_t> starts(items.size());
    for (std::size_t i = 0; i < items.size(); ++i) {
        starts[i] = folded.size();
        for (char c : items[i])
            folded.push_back(static_cast<char>(foldByte(static_cast<unsigned char>(c))));
    }
    for (std::size_t i = 0; i < items.size(); ++i)
        keys[i] = std::string_view(folded).substr(starts[i], items[i].size());
    std::vector<std::size_t> order(items.size());
    for (std::size_t i = 0; i < order.size(); ++i) order[i] = i;
    // Folded texts compare as unsigned bytes, like itemLess; a shorter prefix comes first.
    std::sort(order.begin(), order.end(), [&](std::size_t a, std::size_t b) {
        const int byFold = keys[a].compare(keys[b]);
        if (byFold != 0) return byFold < 0;
        return items[a] < items[b];
    });
    std::vector<std::string> sorted;
    sorted.reserve(items.size());
    for (std::size_t i : order) sorted.push_back(std::move(items[i]));
    items = std::move(sorted);
}

}  // namespace list_order
