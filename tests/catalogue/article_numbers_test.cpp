#include "catalogue/article_numbers.h"

#include <gtest/gtest.h>

#include <stdexcept>
#include <string>

#include "catalogue/list_import.h"
#include "catalogue/records.h"
#include "tests/support/temp_folder.h"

namespace catalogue {
namespace {

TEST(ArticleNumbers, LetterOfTheFirstCharacter) {
    EXPECT_EQ(std::string({articleLetter('A'), articleLetter('a'), articleLetter('z')}), "AAZ");
    for (char c : {'2', ' ', '@', '`', '[', '{', '\0', '\xE9', '\xC9', '\xFF'}) {
        EXPECT_EQ(articleLetter(c), '!') << static_cast<int>(c);
    }
}

// Each case hands out numbers for a run of first characters, one addition after another, and
// ends with the counter text they leave.
TEST(ArticleNumbers, NumbersAndCounterTextsByteForByte) {
    struct Case {
        std::string counter;
        std::string firsts;
        std::string numbers;
        std::string after;
    };
    const Case cases[] = {
        // The worked example; é files under "!".
        {std::string(kSkeletonCounter),
         "AB2a\xE9"
         "b",
         "A001 B001 !001 A002 !002 B002 ", "A#003\r\nB#003\r\n!#003\r\n"},
        {std::string(kSkeletonCounter), "CcC", "C001 C002 C003 ", "A#001\r\nC#004\r\n"},
        {"A#005\r\n\r\nB#003\r\n\r\n", "BQ", "B003 Q001 ", "A#005\r\n\r\nB#004\r\n\r\nQ#002\r\n"},
        {"", "K", "K001 ", "K#002\r\n"},
        {"A#009", "AD", "A009 D001 ", "A#010\r\nD#002\r\n"},  // last line without its CR LF
        {"A#099\r\n", "A", "A099 ", "A#100\r\n"},
        // 999 is the last number: the record then reads 000, other letters go on.
        {"A#998\r\nB#005\r\n", "AAB", "A998 A999 B005 ", "A#000\r\nB#006\r\n"},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.counter + " + " + c.firsts);
        std::string counter = c.counter, numbers;
        for (char first : c.firsts) {
            EXPECT_EQ(counterProblem(counter, articleLetter(first)), CounterProblem::None);
            ArticleNumberResult r = nextArticleNumber(counter, first);
            counter = r.counterText;
            numbers += r.number + " ";
        }
        EXPECT_EQ(numbers, c.numbers);
        EXPECT_EQ(counter, c.after);
    }
}

TEST(ArticleNumbers, UsedUpAndDamagedRecordsAreRefusedForTheirLetterOnly) {
    for (std::string_view text :
         {"A#000\r\nB#006\r\n", "A#0x1\r\n", "A#12\r\n", "A#", "A", "A# 12\r\n", "A#-12\r\n"}) {
        SCOPED_TRACE(text);
        EXPECT_EQ(counterProblem(text, 'A'),
                  text.starts_with("A#000") ? CounterProblem::Exhausted : CounterProblem::Damaged);
        EXPECT_THROW(nextArticleNumber(text, 'a'), std::invalid_argument);
        EXPECT_EQ(counterProblem(text, 'B'), CounterProblem::None);
    }
    EXPECT_EQ(counterProblem("A#001\r\n", '!'), CounterProblem::None);
}

// An import counts a letter's numbers on past its last one exactly as Adds one after another do.
TEST(ArticleNumbers, AnImportHandsOutWhatAddsInARowWould) {
    test_support::TempFolder folder;
    folder.put("pemla.dat", "Rock\r\n");
    folder.put("Rock.dat", "");
    folder.put("Rock.arn", "A#998\r\nB#005\r\n");
    Store store(folder.path());
    const ImportResult r = importCsv(store, "Rock", "title\na1\nA2\nb\nA3\nZed\na4\n");
    EXPECT_EQ(r.added, 4);
    ASSERT_EQ(r.refused.size(), 2u);
    EXPECT_EQ(r.refused[0].line, 5);
    EXPECT_EQ(r.refused[1].reason, r.refused[0].reason);
    EXPECT_NE(r.refused[0].reason.find("letter A (A001 to A999)"), std::string::npos);
    EXPECT_EQ(folder.get("Rock.art"), "a1#*\\A998\r\nA2#*\\A999\r\nb#*\\B005\r\nZed#*\\Z001\r\n");
    EXPECT_EQ(folder.get("Rock.arn"), "A#000\r\nB#006\r\nZ#002\r\n");
}

}  // namespace
}  // namespace catalogue
