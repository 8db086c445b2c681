#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

#include "list_order/list_order.h"

// ISO-8859-1 case handling, in one place. Every lookup that ignores letter case goes through here.
namespace catalogue {

using list_order::foldByte;

// Upper case of one Latin-1 byte: a-z and the accented small letters 0xE0-0xFE except 0xF7.
inline unsigned char upperByte(unsigned char c) {
    if ((c >= 'a' && c <= 'z') || (c >= 0xE0 && c <= 0xFE && c != 0xF7)) return c - 0x20;
    return c;
}

// Whole-text comparison ignoring Latin-1 letter case.
bool equalsIgnoreCase(std::string_view a, std::string_view b);

// First position at or after `from` where `needle` occurs in `hay` ignoring case; npos when none.
// Linear on average, so it is safe on the largest entry texts.
std::size_t findIgnoreCase(std::string_view hay, std::string_view needle, std::size_t from = 0);

// The list boxes' order, which reports and checks of stored files share.
using list_order::itemLess;

}  // namespace catalogue
