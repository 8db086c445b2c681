#include "catalogue/latin1.h"

#include <algorithm>
#include <functional>

namespace catalogue {

namespace {

struct FoldHash {
    std::size_t operator()(char c) const { return foldByte(static_cast<unsigned char>(c)); }
};
struct FoldEqual {
    bool operator()(char a, char b) const {
        return foldByte(static_cast<unsigned char>(a)) == foldByte(static_cast<unsigned char>(b));
    }
};

}  // namespace

bool equalsIgnoreCase(std::string_view a, std::string_view b) {
    return a.size() == b.size() && std::equal(a.begin(), a.end(), b.begin(), FoldEqual{});
}

std::size_t findIgnoreCase(std::string_view hay, std::string_view needle, std::size_t from) {
    if (from > hay.size()) return std::string_view::npos;
    if (needle.empty()) return from;
    std::boyer_moore_horspool_searcher searcher(needle.begin(), needle.end(), FoldHash{},
                                                FoldEqual{});
    auto it = std::search(hay.begin() + static_cast<std::ptrdiff_t>(from), hay.end(), searcher);
    if (it == hay.end()) return std::string_view::npos;
    return static_cast<std::size_t>(it - hay.begin());
}

}  // namespace catalogue
