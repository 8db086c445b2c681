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

// Sorts items into the list-box order. Folds each item once, so long lists sort quickly.
void sortItems(std::vector<std::string>& items);

}  // namespace list_order
