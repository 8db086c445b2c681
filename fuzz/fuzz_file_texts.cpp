// Any bytes as a list index, a flag file or a top text: the line rule and the number reader.
#include <cstdint>
#include <cstdlib>
#include <string>

#include "catalogue/file_text.h"
#include "catalogue/latin1.h"
#include "catalogue/records.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string bytes(reinterpret_cast<const char*>(data), size);
    const std::string text = catalogue::toFileText(bytes);
    if (!text.empty() && !text.ends_with("\r\n")) std::abort();
    if (catalogue::toFileText(text) != text) std::abort();  // reading what we wrote changes nothing
    if (catalogue::forWriting(text) != text) std::abort();
    const auto lines = catalogue::splitLines(bytes);
    if (catalogue::splitLines(text).size() != lines.size()) std::abort();

    // The index: removing a name takes away at most one line.
    if (!lines.empty()) {
        const std::string name(lines[lines.size() / 2]);
        const std::string shorter = catalogue::removeIndexLine(text, name);
        if (catalogue::splitLines(shorter).size() + 1 != lines.size()) std::abort();
    }
    (void)catalogue::firstNumber(bytes);
    for (std::size_t i = 1; i < lines.size(); ++i) {
        if (catalogue::itemLess(lines[i], lines[i - 1]) &&
            catalogue::itemLess(lines[i - 1], lines[i])) {
            std::abort();
        }
    }
    return 0;
}
