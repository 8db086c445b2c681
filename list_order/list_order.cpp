#include "list_order/list_order.h"

#include <algorithm>
#include <array>
#include <bit>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <stdexcept>

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

namespace {

// The indexes of `places` in the order of the texts they give in `bytes`.
std::vector<std::size_t> orderOf(std::string_view bytes, const std::vector<Items::Place>& places) {
    const std::size_t count = places.size();
    const auto text = [&](std::size_t i) { return bytes.substr(places[i].at, places[i].size); };
    // Every text folded once into one buffer; the sort then compares plain bytes, and mostly
    // only the first sixteen of them, held next to the text's number.
    std::size_t total = 0;
    for (std::size_t i = 0; i < count; ++i) total += text(i).size();
    std::string folded(total + 16, '\0');  // sixteen bytes spare: each head is read whole
    std::vector<std::size_t> starts(count + 1);
    char* to = folded.data();
    for (std::size_t i = 0; i < count; ++i) {
        starts[i] = static_cast<std::size_t>(to - folded.data());
        for (const char c : text(i))
            *to++ = static_cast<char>(kFoldTable[static_cast<unsigned char>(c)]);
    }
    starts[count] = total;
    const auto key = [&](std::size_t i) {
        return std::string_view(folded).substr(starts[i], starts[i + 1] - starts[i]);
    };
    struct Head {
        // The first sixteen folded bytes, the first one highest; zeros after the text.
        std::uint64_t high, low;
        std::size_t item;
    };
    std::vector<Head> heads(count);
    for (std::size_t i = 0; i < count; ++i) {
        const std::string_view k = key(i);
        heads[i] = {headPart(k, 0), headPart(k, 8), i};
    }
    // Heads that differ order the texts as their folded texts do (unsigned bytes, a shorter
    // prefix first); equal heads leave it to the whole texts, then to the texts themselves.
    const auto less = [&](const Head& a, const Head& b) {
        if (a.high != b.high) return a.high < b.high;
        if (a.low != b.low) return a.low < b.low;
        const int byFold = key(a.item).compare(key(b.item));
        if (byFold != 0) return byFold < 0;
        return text(a.item) < text(b.item);
    };
    // The first eight bytes are sorted by their digits, eleven bits at a time and without a
    // single comparison; only the runs that share them are then sorted by comparing.
    std::vector<Head> spare(count);
    constexpr int kBits = 11;
    for (int shift = 0; shift < 64; shift += kBits) {
        // Where the heads of each digit go: counted, then summed up.
        std::array<std::size_t, (1 << kBits) + 1> places{};
        const auto digit = [shift](const Head& h) {
            return static_cast<std::size_t>(h.high >> shift) & ((1u << kBits) - 1);
        };
        for (const Head& h : heads) ++places[digit(h) + 1];
        if (std::find(places.begin(), places.end(), count) != places.end()) continue;  // one digit
        for (std::size_t d = 1; d < places.size(); ++d) places[d] += places[d - 1];
        for (const Head& h : heads) spare[places[digit(h)]++] = h;
        heads.swap(spare);
    }
    for (auto run = heads.begin(); run != heads.end();) {
        const auto end =
            std::find_if(run + 1, heads.end(), [&](const Head& h) { return h.high != run->high; });
        if (end - run > 1) std::sort(run, end, less);
        run = end;
    }
    std::vector<std::size_t> order(count);
    for (std::size_t i = 0; i < count; ++i) order[i] = heads[i].item;
    return order;
}

}  // namespace

Items::Items(const std::vector<std::string>& texts) {
    places_.reserve(texts.size());
    for (const std::string& text : texts) {
        places_.push_back({bytes_.size(), text.size()});
        bytes_ += text;
    }
    *this = Items(std::move(bytes_), std::move(places_));
}

Items::Items(std::string bytes, std::vector<Place> places) : bytes_(std::move(bytes)) {
    const std::vector<std::size_t> order = orderOf(bytes_, places);
    places_.reserve(places.size());
    for (const std::size_t i : order) places_.push_back(places[i]);
}

std::string_view Items::at(std::size_t i) const {
    if (i >= places_.size()) throw std::out_of_range("list item");
    return (*this)[i];
}

std::size_t Items::placeFor(std::string_view text) const {
    const auto place = std::upper_bound(places_.begin(), places_.end(), text,
                                        [&](std::string_view t, const Place& p) {
                                            return itemLess(t, {bytes_.data() + p.at, p.size});
                                        });
    return static_cast<std::size_t>(place - places_.begin());
}

std::size_t Items::find(std::string_view text) const {
    const auto place = std::lower_bound(places_.begin(), places_.end(), text,
                                        [&](const Place& p, std::string_view t) {
                                            return itemLess({bytes_.data() + p.at, p.size}, t);
                                        });
    const std::size_t index = static_cast<std::size_t>(place - places_.begin());
    return index < size() && (*this)[index] == text ? index : npos;
}

std::size_t Items::insert(std::string_view text) {
    const std::size_t index = placeFor(text);
    const Place added{bytes_.size(), text.size()};
    bytes_.append(text);  // may be one of these very texts: append copies before it frees
    places_.insert(places_.begin() + static_cast<std::ptrdiff_t>(index), added);
    return index;
}

std::size_t Items::remove(std::string_view text) {
    const std::size_t index = find(text);
    if (index == npos) return npos;
    const auto place = places_.begin() + static_cast<std::ptrdiff_t>(index);
    unused_ += place->size;
    places_.erase(place);
    // Texts taken out leave their bytes behind; once they are most of the buffer, it is packed.
    if (unused_ > 4096 && unused_ > bytes_.size() / 2) {
        std::string packed;
        packed.reserve(bytes_.size() - unused_);
        for (Place& p : places_) {
            packed.append(bytes_, p.at, p.size);
            p.at = packed.size() - p.size;
        }
        bytes_ = std::move(packed);
        unused_ = 0;
    }
    return index;
}

std::vector<std::string> Items::strings() const {
    std::vector<std::string> texts;
    texts.reserve(size());
    for (std::size_t i = 0; i < size(); ++i) texts.emplace_back((*this)[i]);
    return texts;
}

}  // namespace list_order
