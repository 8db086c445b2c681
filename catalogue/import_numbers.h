#pragma once

#include <array>
#include <cstring>
#include <optional>
#include <string>
#include <utility>

#include "catalogue/article_numbers.h"
#include "catalogue/entry_rules.h"

// The article numbers an import hands out, row after row.
namespace catalogue::import_numbers {

// The letter each first character files under, looked up once per row.
inline const std::array<char, 256> kLetters = [] {
    std::array<char, 256> letters{};
    for (std::size_t c = 0; c < letters.size(); ++c) {
        letters[c] = articleLetter(static_cast<char>(c));
    }
    return letters;
}();

// Article numbers handed out row after row. The first number of each letter goes through
// handOutNumber(), which also says why a letter has none left; later ones are counted here and
// written into the counter text once, at the end.
class Counters {
  public:
    Counters() = default;
    Counters(std::string text, std::string file) : text_(std::move(text)), file_(std::move(file)) {}

    // Writes the next number for a title's first character to `number`; false and the reason in
    // `refusal` when its letter has none left. Throws CatalogueError for a damaged record.
    bool handOut(char firstCharacter, char (&number)[4], std::string& refusal) {
        const char letter = kLetters[static_cast<unsigned char>(firstCharacter)];
        Letter& l = letters_[letter == '!' ? 26 : letter - 'A'];
        if (l.state == State::Counting) {
            if (std::memcmp(l.next, "000", 3) != 0) {
                number[0] = letter;
                std::memcpy(number + 1, l.next, 3);
                advance(l.next);
                return true;
            }
            flush();  // used up here: the text says so, and handOutNumber() words the refusal
            l.state = State::Unused;
        }
        if (l.state == State::Refused) {
            refusal = l.refusal;
            return false;
        }
        std::optional<ArticleNumberResult> next =
            handOutNumber(text_, file_, firstCharacter, refusal);
        if (!next) {
            l.state = State::Refused;
            l.refusal = refusal;
            return false;
        }
        text_ = std::move(next->counterText);
        std::memcpy(number, next->number.data(), 4);
        // The letter's record is the first occurrence of the letter; its digits follow "#".
        l.digits = text_.find(letter) + 2;
        std::memcpy(l.next, text_.data() + l.digits, 3);
        l.state = State::Counting;
        return true;
    }

    // The counter text with every number handed out counted in.
    const std::string& text() {
        flush();
        return text_;
    }

  private:
    enum class State { Unused, Counting, Refused };
    struct Letter {
        State state = State::Unused;
        std::size_t digits = 0;  // where the record's three digits stand in the text
        char next[3] = {};       // the digits of the next number to hand out
        std::string refusal;
    };

    // Counts three digits on by one; 999 goes to "000", which marks the letter used up.
    static void advance(char (&digits)[3]) {
        for (int i = 2; i >= 0; --i) {
            if (digits[i] != '9') {
                ++digits[i];
                return;
            }
            digits[i] = '0';
        }
    }

    // Writes the counted numbers into the text. Digits never hold a letter, so no record moves.
    void flush() {
        for (const Letter& l : letters_) {
            if (l.state == State::Counting) std::memcpy(text_.data() + l.digits, l.next, 3);
        }
    }

    std::string text_;
    std::string file_;
    std::array<Letter, 27> letters_;  // A to Z, then "!"
};

}  // namespace catalogue::import_numbers
