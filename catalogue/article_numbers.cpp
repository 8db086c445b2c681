#include "catalogue/article_numbers.h"

#include <stdexcept>

#include "catalogue/file_text.h"
#include "catalogue/latin1.h"

namespace catalogue {

namespace {

bool threeDigits(std::string_view digits) {
    if (digits.size() != 3) return false;
    for (char c : digits) {
        if (c < '0' || c > '9') return false;
    }
    return true;
}

}  // namespace

char articleLetter(char firstCharacter) {
    const unsigned char upper = upperByte(static_cast<unsigned char>(firstCharacter));
    return (upper < 'A' || upper > 'Z') ? '!' : static_cast<char>(upper);
}

CounterProblem counterProblem(std::string_view counterText, char letter) {
    const std::size_t at = counterText.find(letter);
    if (at == std::string_view::npos) return CounterProblem::None;
    if (at + 2 > counterText.size()) return CounterProblem::Damaged;
    const std::string_view digits = counterText.substr(at + 2, 3);
    if (!threeDigits(digits)) return CounterProblem::Damaged;
    if (digits == "000") return CounterProblem::Exhausted;
    return CounterProblem::None;
}

ArticleNumberResult nextArticleNumber(std::string_view counterText, char firstCharacter) {
    const char letter = articleLetter(firstCharacter);
    if (counterProblem(counterText, letter) != CounterProblem::None) {
        throw std::invalid_argument("no article number left for this letter");
    }
    ArticleNumberResult result;
    const std::size_t at = counterText.find(letter);
    if (at == std::string_view::npos) {
        result.number = std::string(1, letter) + "001";
        result.counterText = forWriting(counterText);
        result.counterText.append(1, letter).append("#002").append(kCrLf);
        return result;
    }
    const std::string digits(counterText.substr(at + 2, 3));
    result.number = std::string(1, letter) + digits;
    const int next = (std::stoi(digits) + 1) % 1000;  // 999 -> "000": used up
    std::string stored = std::to_string(next);
    stored.insert(0, 3 - stored.size(), '0');
    result.counterText = std::string(counterText);
    result.counterText.replace(at + 2, 3, stored);
    return result;
}

}  // namespace catalogue
