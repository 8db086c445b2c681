#pragma once

#include <string>
#include <string_view>

// Article numbers: a letter (A-Z, or "!" for any other first character) and three digits,
// counted per letter in the list's counter file (records "A#002": the next number to hand out).
namespace catalogue {

// The letter a title's first character files under.
char articleLetter(char firstCharacter);

struct ArticleNumberResult {
    std::string number;       // handed out, such as "A001"
    std::string counterText;  // the counter file text to store afterwards
};

enum class CounterProblem { None, Exhausted, Damaged };

// What stands in the way of handing out the next number for `letter`: its record has handed out
// 999 already (stored as "000"), or its digits are not three digits.
CounterProblem counterProblem(std::string_view counterText, char letter);

// Hands out the next number for a title's first character and advances the counter text. The
// letter's record is the first occurrence of the letter in the text; a letter without one gets
// 001 and a new record "#002" at the end. After 999 the record is stored as "000", which marks
// the letter as used up. Throws std::invalid_argument when counterProblem() is not None.
ArticleNumberResult nextArticleNumber(std::string_view counterText, char firstCharacter);

}  // namespace catalogue
