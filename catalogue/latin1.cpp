#include "catalogue/latin1.h"

#include <algorithm>
#include <array>

namespace catalogue {

namespace {

struct FoldEqual {
    bool operator()(char a, char b) const {
        return foldByte(static_cast<unsigned char>(a)) == foldByte(static_cast<unsigned char>(b));
    }
};

}  // namespace

bool equalsIgnoreCase(std::string_view a, std::string_view b) {
    if (a.size() != b.size()) return false;
    // Texts compared ignoring case are mostly spelt alike: the plain comparison settles those.
    return a == b || std::equal(a.begin(), a.end(), b.begin(), FoldEqual{});
}

std::size_t findIgnoreCase(std::string_view hay, std::string_view needle, std::size_t from) {
    if (from > hay.size()) return std::string_view::npos;
    const std::size_t m = needle.size();
    if (m == 0) return from;
    if (hay.size() - from < m) return std::string_view::npos;
    // Horspool's search on folded bytes, its shifts in a plain table: a whole list's text is
    // searched on every add, so each byte looked at has to cost little.
    std::string folded(needle);
    for (char& c : folded) c = static_cast<char>(foldByte(static_cast<unsigned char>(c)));
    std::array<std::size_t, 256> shift;
    shift.fill(m);
    for (std::size_t i = 0; i + 1 < m; ++i) {
        shift[static_cast<unsigned char>(folded[i])] = m - 1 - i;
    }
    const auto foldAt = [&](std::size_t at) {
        return foldByte(static_cast<unsigned char>(hay[at]));
    };
    const auto last = static_cast<unsigned char>(folded[m - 1]);
    for (std::size_t at = from; at + m <= hay.size();) {
        const unsigned char end = foldAt(at + m - 1);
        if (end == last) {
            std::size_t i = 0;
            while (i + 1 < m && foldAt(at + i) == static_cast<unsigned char>(folded[i])) ++i;
            if (i + 1 == m) return at;
        }
        at += shift[end];
    }
    return std::string_view::npos;
}

}  // namespace catalogue
