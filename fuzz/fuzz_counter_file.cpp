// Any bytes as a counter file, with the first byte as a title's first character.
#include <cstdint>
#include <cstdlib>
#include <string>

#include "catalogue/article_numbers.h"
#include "catalogue/file_text.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    if (size == 0) return 0;
    const char first = static_cast<char>(data[0]);
    const std::string counter =
        catalogue::toFileText(std::string(reinterpret_cast<const char*>(data) + 1, size - 1));
    const char letter = catalogue::articleLetter(first);
    if (catalogue::counterProblem(counter, letter) != catalogue::CounterProblem::None) return 0;
    const auto next = catalogue::nextArticleNumber(counter, first);
    if (next.number.size() != 4 || next.number[0] != letter) std::abort();
    for (std::size_t i = 1; i < 4; ++i) {
        if (next.number[i] < '0' || next.number[i] > '9') std::abort();
    }
    if (next.number == std::string(1, letter) + "000") std::abort();  // never a used-up number
    return 0;
}
