#pragma once

#include <array>
#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

// The order every list box shows its items in, and the Latin-1 letter case it folds. Kept apart
// from the catalogue so the window controls can sort without reaching into the file code.
namespace list_order {

// Folds one Latin-1 byte to lower case: A-Z and the accented capitals 0xC0-0xDE except 0xD7.
inline unsigned char foldByte(unsigned char c) {
    if ((c >= 'A' && c <= 'Z') || (c >= 0xC0 && c <= 0xDE && c != 0xD7)) return c + 0x20;
    return c;
}

// foldByte() of every byte, for loops that fold long texts.
inline const std::array<unsigned char, 256> kFoldTable = [] {
    std::array<unsigned char, 256> table{};
    for (std::size_t c = 0; c < table.size(); ++c)
        table[c] = foldByte(static_cast<unsigned char>(c));
    return table;
}();

// Case-insensitive, ties broken by byte value.
bool itemLess(std::string_view a, std::string_view b);

// Texts kept in the list-box order, all in one buffer: a list of 32,767 titles takes a few
// allocations instead of one per title, and sorting it moves only where each text stands.
class Items {
  public:
    // Where one text stands in the buffer.
    struct Place {
        std::size_t at, size;
    };

    Items() = default;
    Items(const std::vector<std::string>& texts);  // NOLINT: a list box takes a few names so
    // The texts `bytes` holds at `places`, sorted.
    Items(std::string bytes, std::vector<Place> places);

    std::size_t size() const { return places_.size(); }
    bool empty() const { return places_.empty(); }
    std::string_view operator[](std::size_t i) const {
        return {bytes_.data() + places_[i].at, places_[i].size};
    }
    // As [], but throws std::out_of_range past the end.
    std::string_view at(std::size_t i) const;
    // The index insert() puts `text` at.
    std::size_t placeFor(std::string_view text) const;
    // Puts `text` at its place, after any equal one; returns its index.
    std::size_t insert(std::string_view text);
    // The index of the text equal to `text`, or npos.
    std::size_t find(std::string_view text) const;
    // Takes out the text equal to `text`; returns the index it had, or npos when there is none.
    std::size_t remove(std::string_view text);
    std::vector<std::string> strings() const;

    static constexpr std::size_t npos = static_cast<std::size_t>(-1);

  private:
    std::string bytes_;
    std::vector<Place> places_;
    std::size_t unused_ = 0;  // bytes of texts taken out
};

}  // namespace list_order
