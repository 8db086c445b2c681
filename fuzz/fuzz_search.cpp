// Any bytes as an article file searched for any number: what is shown is always a piece of the
// text read, never more than its line.
#include <cstdint>
#include <cstdlib>
#include <string>

#include "catalogue/file_text.h"
#include "search/form_searchart.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    if (size == 0) return 0;
    const std::size_t numberLength = std::min<std::size_t>(data[0] % 6, size - 1);
    const std::string number(reinterpret_cast<const char*>(data) + 1, numberLength);
    const std::string articleText =
        "\r\n" +
        catalogue::toFileText(std::string(reinterpret_cast<const char*>(data) + 1 + numberLength,
                                          size - 1 - numberLength));
    const auto title = search::titleBefore(articleText, number);
    if (!title) return 0;
    if (articleText.find(*title) == std::string::npos) std::abort();
    if (title->find('\n') != std::string::npos) std::abort();
    return 0;
}
