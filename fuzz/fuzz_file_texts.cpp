// Any bytes as a list index, a flag file or a top text: the line rule and the number reader.
#include "catalogue/file_text.h"
#include "catalogue/latin1.h"
#include "catalogue/records.h"
#include "fuzz/fuzz_target.h"

void fuzzOne(const std::string& bytes) {
    const std::string text = catalogue::toFileText(bytes);
    check(text.empty() || text.ends_with("\r\n"));
    for (std::size_t cr = text.find('\r'); cr != std::string::npos; cr = text.find('\r', cr + 1)) {
        check(text[cr + 1] == '\n');
    }
    check(catalogue::toFileText(text) == text);  // reading what we wrote changes nothing
    check(catalogue::forWriting(text) == text);
    const auto lines = catalogue::splitLines(bytes);
    check(catalogue::splitLines(text).size() == lines.size());
    // The index: removing a name takes away at most one line.
    if (!lines.empty()) {
        const std::string name(lines[lines.size() / 2]);
        const std::string shorter = catalogue::removeIndexLine(text, name);
        check(catalogue::splitLines(shorter).size() + 1 == lines.size());
    }
    (void)catalogue::firstNumber(bytes);
    for (std::size_t i = 1; i < lines.size(); ++i) {
        check(!catalogue::itemLess(lines[i], lines[i - 1]) ||
              !catalogue::itemLess(lines[i - 1], lines[i]));
    }
}
