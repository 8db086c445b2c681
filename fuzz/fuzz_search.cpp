// Any bytes as an article file searched for any number: what is shown is always a piece of the
// text read, never more than its line.
#include "catalogue/file_text.h"
#include "fuzz/fuzz_target.h"
#include "search/form_searchart.h"

void fuzzOne(const std::string& bytes) {
    if (bytes.empty()) return;
    const std::size_t length =
        std::min<std::size_t>(static_cast<unsigned char>(bytes[0]) % 6, bytes.size() - 1);
    const std::string number = bytes.substr(1, length);
    const std::string articleText = "\r\n" + catalogue::toFileText(bytes.substr(1 + length));
    const auto title = search::titleBefore(articleText, number);
    if (!title) return;
    check(articleText.find(*title) != std::string::npos && title->find('\n') == std::string::npos);
}
