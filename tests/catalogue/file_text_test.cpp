#include "catalogue/file_text.h"

#include <gtest/gtest.h>

#include <climits>
#include <string>
#include <vector>

namespace catalogue {
namespace {

std::vector<std::string> lines(std::string_view bytes) {
    std::vector<std::string> out;
    for (std::string_view line : splitLines(bytes)) out.emplace_back(line);
    return out;
}

TEST(FileText, LineRuleEndsAtCrAndSkipsOneLf) {
    using V = std::vector<std::string>;
    EXPECT_EQ(lines(""), V{});
    EXPECT_EQ(lines("a\r\nb\r\n"), (V{"a", "b"}));
    EXPECT_EQ(lines("a\r\nb"), (V{"a", "b"}));  // the end of the file ends the last line
    EXPECT_EQ(lines("a\rb\r"), (V{"a", "b"}));
    EXPECT_EQ(lines("x\r\r\ny"), (V{"x", "", "y"}));
    EXPECT_EQ(lines("\r\n\r\n"), (V{"", ""}));
    // A lone LF is data, and only one LF after a CR belongs to the line end.
    EXPECT_EQ(lines("a\nb"), V{"a\nb"});
    EXPECT_EQ(lines("a\r\n\nb"), (V{"a", "\nb"}));
    EXPECT_EQ(lines("\n"), V{"\n"});
    EXPECT_EQ(lines("\xE9t\xE9\r\n"), V{"\xE9t\xE9"});  // bytes pass unchanged
}

TEST(FileText, ReadingAsTextFollowsEveryLineWithCrLf) {
    EXPECT_EQ(toFileText(""), "");
    EXPECT_EQ(toFileText("a\r\nb\r\n"), "a\r\nb\r\n");
    EXPECT_EQ(toFileText("a\rb"), "a\r\nb\r\n");
    EXPECT_EQ(toFileText("a\r\n\r\n"), "a\r\n\r\n");
    EXPECT_EQ(toFileText("a\nb"), "a\nb\r\n");
    EXPECT_EQ(toFileText("a\r\n\nb"), "a\r\n\nb\r\n");
    EXPECT_EQ(toFileText("\r"), "\r\n");
    const std::string written = "<|?T\r\n<|'CD\r\n<||1\r\n<|*\r\n";
    EXPECT_EQ(toFileText(written), written);
}

TEST(FileText, ForWritingAddsCrLfOnlyWhenMissing) {
    EXPECT_EQ(forWriting(""), "");
    EXPECT_EQ(forWriting("a"), "a\r\n");
    EXPECT_EQ(forWriting("a\r\n"), "a\r\n");
    EXPECT_EQ(forWriting("a\r\nb"), "a\r\nb\r\n");
    EXPECT_EQ(forWriting("\r\n"), "\r\n");
    EXPECT_EQ(forWriting("a\r\n\r\n"), "a\r\n\r\n");  // an existing empty line stays, none added
}

TEST(FileText, FirstNumber) {
    EXPECT_EQ(firstNumber(" 1 "), 1);
    EXPECT_EQ(firstNumber(" 0 \r\n"), 0);
    EXPECT_EQ(firstNumber("0"), 0);
    EXPECT_EQ(firstNumber("-3"), -3);
    EXPECT_EQ(firstNumber("+5"), 5);
    EXPECT_EQ(firstNumber("12abc"), 12);
    EXPECT_EQ(firstNumber("\t7"), 7);
    EXPECT_EQ(firstNumber(std::to_string(LONG_MAX)), LONG_MAX);
    EXPECT_EQ(firstNumber(""), std::nullopt);
    EXPECT_EQ(firstNumber("   "), std::nullopt);
    EXPECT_EQ(firstNumber("abc"), std::nullopt);
    EXPECT_EQ(firstNumber("- 3"), std::nullopt);
    EXPECT_EQ(firstNumber("\r\n1"), std::nullopt);
    EXPECT_EQ(firstNumber("99999999999999999999"), std::nullopt);
    EXPECT_EQ(firstNumber(std::to_string(LONG_MAX) + "0"), std::nullopt);

    EXPECT_EQ(leadingNumber("  7 x"), 7);
    EXPECT_EQ(leadingNumber("x7"), 0);
    EXPECT_EQ(leadingNumber(""), 0);
}

TEST(FileText, NumbersForFilesAndLabels) {
    EXPECT_EQ(fileNumber(1), " 1 ");
    EXPECT_EQ(fileNumber(0), " 0 ");
    EXPECT_EQ(fileNumber(-3), "-3 ");
    EXPECT_EQ(labelNumber(12), " 12");
    EXPECT_EQ(labelNumber(0), " 0");
    EXPECT_EQ(labelNumber(-3), "-3");
    EXPECT_EQ(labelNumber(32767), " 32767");
}

}  // namespace
}  // namespace catalogue
