#include "catalogue/file_text.h"

#include <gtest/gtest.h>

namespace catalogue {
namespace {

TEST(FileText, LineRuleEndsAtCrAndSkipsOneLf) {
    EXPECT_EQ(toFileText(""), "");
    EXPECT_EQ(toFileText("a\r\nb\r\n"), "a\r\nb\r\n");
    EXPECT_EQ(toFileText("a\rb"), "a\r\nb\r\n");
    EXPECT_EQ(toFileText("a\r\n\r\n"), "a\r\n\r\n");
    // A lone LF is data, not a line end.
    EXPECT_EQ(toFileText("a\nb"), "a\nb\r\n");
    EXPECT_EQ(toFileText("a\r\n\nb"), "a\r\n\nb\r\n");
    EXPECT_EQ(splitLines("x\r\r\ny").size(), 3u);
}

}  // namespace
}  // namespace catalogue
