#include "catalogue/latin1.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <string>
#include <vector>

namespace catalogue {
namespace {

constexpr auto npos = std::string_view::npos;

TEST(Latin1, FoldsAsciiAndAccentedLettersOnly) {
    EXPECT_TRUE(equalsIgnoreCase("Star Wars", "sTAR wARS"));
    EXPECT_TRUE(equalsIgnoreCase("\xC9t\xC9", "\xE9T\xE9"));  // ÉtÉ / éTé
    EXPECT_TRUE(equalsIgnoreCase("\xC0\xDE", "\xE0\xFE"));  // À Þ / à þ, the ends of the range
    EXPECT_FALSE(equalsIgnoreCase("\xD7", "\xF7"));         // × and ÷ are no letter pair
    EXPECT_FALSE(equalsIgnoreCase("\xDF", "\xFF"));         // ß and ÿ have no capital here
    EXPECT_FALSE(equalsIgnoreCase("@", "`"));               // neighbours of A-Z, 0x20 apart
    EXPECT_FALSE(equalsIgnoreCase("[", "{"));
    EXPECT_FALSE(equalsIgnoreCase("abc", "abcd"));
    EXPECT_TRUE(equalsIgnoreCase("", ""));

    for (int c = 0; c < 256; ++c) {
        const auto b = static_cast<unsigned char>(c);
        const bool capital = (b >= 'A' && b <= 'Z') || (b >= 0xC0 && b <= 0xDE && b != 0xD7);
        EXPECT_EQ(foldByte(b), capital ? b + 0x20 : b) << c;
        if (capital) {
            EXPECT_EQ(upperByte(static_cast<unsigned char>(b + 0x20)), b) << c;
        }
    }
    EXPECT_EQ(upperByte(0xFF), 0xFF);
    EXPECT_EQ(upperByte(0xF7), 0xF7);
    EXPECT_EQ(upperByte(0xDF), 0xDF);
}

TEST(Latin1, FindIgnoreCase) {
    EXPECT_EQ(findIgnoreCase("x <|?CAF\xC9\r", "<|?caf\xE9\r"), 2u);
    EXPECT_EQ(findIgnoreCase("abcABC", "abc", 1), 3u);
    EXPECT_EQ(findIgnoreCase("abc", "ABC", 3), npos);
    EXPECT_EQ(findIgnoreCase("abc", "", 2), 2u);
    EXPECT_EQ(findIgnoreCase("abc", "a", 4), npos);
    EXPECT_EQ(findIgnoreCase("\xD7\xF7", "\xF7\xF7"), npos);
    EXPECT_EQ(findIgnoreCase("Gro\xDF", "GRO\xFF"), npos);
    EXPECT_EQ(findIgnoreCase("ab", "abc"), npos);
    // A long text of near misses still finds the one real occurrence at its end.
    std::string hay(100000, 'a');
    hay += "aAB";
    EXPECT_EQ(findIgnoreCase(hay, "AAB"), 99999u + 1);
}

TEST(Latin1, ItemOrderIgnoresCaseAndBreaksTiesByByte) {
    std::vector<std::string> items = {"ABD", "Abc", "abc", "b"};
    std::sort(items.begin(), items.end(),
              [](const auto& a, const auto& b) { return itemLess(a, b); });
    EXPECT_EQ(items, (std::vector<std::string>{"Abc", "abc", "ABD", "b"}));

    EXPECT_TRUE(itemLess("ab", "ABC"));  // a prefix sorts first
    EXPECT_FALSE(itemLess("abc", "abc"));
    EXPECT_TRUE(itemLess("\xC9t\xE9", "\xE9t\xE9"));  // É before é on a tie
    EXPECT_TRUE(itemLess("Z", "\xE9"));               // accented letters after z
}

}  // namespace
}  // namespace catalogue
