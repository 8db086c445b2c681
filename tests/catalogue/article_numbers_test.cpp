#include "catalogue/article_numbers.h"

#include <gtest/gtest.h>

#include <stdexcept>
#include <string>

#include "catalogue/records.h"

namespace catalogue {
namespace {

// Hands out a number for `first` and keeps the advanced counter text, as one addition does.
std::string take(std::string& counter, char first) {
    ArticleNumberResult r = nextArticleNumber(counter, first);
    counter = r.counterText;
    return r.number;
}

TEST(ArticleNumbers, LetterOfTheFirstCharacter) {
    EXPECT_EQ(articleLetter('A'), 'A');
    EXPECT_EQ(articleLetter('a'), 'A');
    EXPECT_EQ(articleLetter('z'), 'Z');
    for (char c : {'2', ' ', '(', '[', '@', '`', '{', '!', '#', '\0', '\xE9', '\xC9', '\xFF'}) {
        EXPECT_EQ(articleLetter(c), '!') << static_cast<int>(c);
    }
}

TEST(ArticleNumbers, WorkedExample) {
    std::string counter(kSkeletonCounter);
    EXPECT_EQ(take(counter, 'A'), "A001");
    EXPECT_EQ(counter, "A#002\r\n");
    EXPECT_EQ(take(counter, 'B'), "B001");
    EXPECT_EQ(counter, "A#002\r\nB#002\r\n");
    EXPECT_EQ(take(counter, '2'), "!001");
    EXPECT_EQ(counter, "A#002\r\nB#002\r\n!#002\r\n");
    EXPECT_EQ(take(counter, 'a'), "A002");
    EXPECT_EQ(take(counter, '\xE9'), "!002");  // é files under "!"
    EXPECT_EQ(take(counter, 'b'), "B002");
    EXPECT_EQ(counter, "A#003\r\nB#003\r\n!#003\r\n");
}

TEST(ArticleNumbers, ThreeTitlesOfANewLetter) {
    std::string counter(kSkeletonCounter);
    EXPECT_EQ(take(counter, 'C'), "C001");
    EXPECT_EQ(take(counter, 'c'), "C002");
    EXPECT_EQ(take(counter, 'C'), "C003");
    EXPECT_EQ(counter, "A#001\r\nC#004\r\n");
}

TEST(ArticleNumbers, CounterFilesWithEmptyLinesOrNoLines) {
    std::string counter = "A#005\r\n\r\nB#003\r\n\r\n";
    EXPECT_EQ(take(counter, 'B'), "B003");
    EXPECT_EQ(counter, "A#005\r\n\r\nB#004\r\n\r\n");
    EXPECT_EQ(take(counter, 'Q'), "Q001");
    EXPECT_EQ(counter, "A#005\r\n\r\nB#004\r\n\r\nQ#002\r\n");

    counter = "";
    EXPECT_EQ(take(counter, 'K'), "K001");
    EXPECT_EQ(counter, "K#002\r\n");
    counter = "A#009";  // a last line still without its CR LF
    EXPECT_EQ(take(counter, 'A'), "A009");
    EXPECT_EQ(counter.substr(0, 5), "A#010");
    EXPECT_EQ(take(counter, 'D'), "D001");
    EXPECT_EQ(counter, "A#010\r\nD#002\r\n");
    counter = "A#099\r\n";
    EXPECT_EQ(take(counter, 'A'), "A099");
    EXPECT_EQ(counter, "A#100\r\n");
}

TEST(ArticleNumbers, NineNinetyNineIsTheLastNumber) {
    std::string counter = "A#998\r\nB#005\r\n";
    EXPECT_EQ(take(counter, 'A'), "A998");
    EXPECT_EQ(counter, "A#999\r\nB#005\r\n");
    EXPECT_EQ(counterProblem(counter, 'A'), CounterProblem::None);
    EXPECT_EQ(take(counter, 'A'), "A999");
    EXPECT_EQ(counter, "A#000\r\nB#005\r\n");
    EXPECT_EQ(counterProblem(counter, 'A'), CounterProblem::Exhausted);
    EXPECT_THROW(nextArticleNumber(counter, 'a'), std::invalid_argument);
    // Other letters go on; A's used-up record stays as it is.
    EXPECT_EQ(counterProblem(counter, 'B'), CounterProblem::None);
    EXPECT_EQ(take(counter, 'B'), "B005");
    EXPECT_EQ(counter, "A#000\r\nB#006\r\n");
}

TEST(ArticleNumbers, DamagedDigits) {
    for (std::string_view text : {"A#0x1\r\n", "A#12\r\n", "A#", "A", "A# 12\r\n", "A#-12\r\n"}) {
        EXPECT_EQ(counterProblem(text, 'A'), CounterProblem::Damaged) << text;
        EXPECT_THROW(nextArticleNumber(text, 'A'), std::invalid_argument) << text;
        EXPECT_EQ(counterProblem(text, 'B'), CounterProblem::None) << text;
    }
    EXPECT_EQ(counterProblem("", 'A'), CounterProblem::None);
    EXPECT_EQ(counterProblem("A#001\r\n", '!'), CounterProblem::None);
}

}  // namespace
}  // namespace catalogue
