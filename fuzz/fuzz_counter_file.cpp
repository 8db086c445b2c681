// Any bytes as a counter file, with the first byte as a title's first character.
#include "catalogue/article_numbers.h"
#include "catalogue/file_text.h"
#include "fuzz/fuzz_target.h"

void fuzzOne(const std::string& bytes) {
    if (bytes.empty()) return;
    const std::string counter = catalogue::toFileText(bytes.substr(1));
    const char letter = catalogue::articleLetter(bytes[0]);
    if (catalogue::counterProblem(counter, letter) != catalogue::CounterProblem::None) return;
    const std::string number = catalogue::nextArticleNumber(counter, bytes[0]).number;
    check(number.size() == 4 && number[0] == letter);
    check(number.find_first_not_of("0123456789", 1) == std::string::npos);
    check(number.substr(1) != "000");  // never a used-up number
}
