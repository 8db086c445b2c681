#include "bench/catalogue_maker.h"

#include <fstream>
#include <map>
#include <stdexcept>
#include <vector>

#include "catalogue/article_numbers.h"

namespace bench {

namespace {

void put(const std::string& path, const std::string& bytes) {
    std::ofstream out(path, std::ios::binary | std::ios::trunc);
    out << bytes;
    if (!out) throw std::runtime_error("cannot write " + path);
}

}  // namespace

void writeList(const std::string& folder, const std::string& name, int entries) {
    static const std::vector<std::string> starts = {
        "Abbey",  "Blue", "Cosmic", "Dark",      "Echoes", "Fire",   "Golden", "Hidden",
        "Iron",   "Jazz", "King",   "Lost",      "Moon",   "Night",  "Ocean",  "Paper",
        "Quiet",  "Red",  "Silver", "Time",      "Under",  "Velvet", "Wild",   "Xeno",
        "Yellow", "Zero", "2001",   "\xC9t\xE9", "(Live)"};
    static const std::vector<std::string> ends = {
        "Road", "Dreams", "Nights", "Collection", "Live at the Hall", "Part II", "Odyssey"};
    static const std::vector<std::string> types = {"Music CD", "DVD video", "Game", "Software",
                                                   "Audiobook"};
    static const std::vector<std::string> infos = {"Original", "Copy", "Lent out", "Boxed"};
    std::string dat;
    std::string art;
    std::map<char, int> next;
    std::vector<char> order;
    for (int i = 0; i < entries; ++i) {
        const std::string title = starts[static_cast<std::size_t>(i) % starts.size()] + " " +
                                  ends[static_cast<std::size_t>(i / 29) % ends.size()] + " " +
                                  std::to_string(i);
        dat += "<|?" + title + "\r\n<|'" + types[static_cast<std::size_t>(i) % types.size()] +
               "\r\n<||" + std::to_string(1 + i % 3) + "\r\n<|*" +
               infos[static_cast<std::size_t>(i) % infos.size()] + "\r\n";
        const char letter = catalogue::articleLetter(title[0]);
        if (!next.count(letter)) order.push_back(letter);
        const int number = ++next[letter];
        std::string digits = std::to_string(number % 1000);
        digits.insert(0, 3 - digits.size(), '0');
        art += title + "#*\\" + letter + digits + "\r\n";
    }
    // A letter holds at most 999 numbers, fewer than a full list has titles per letter, so the
    // generated numbers repeat; the counters leave room for the operations measured.
    std::string arn;
    for (char letter : order) arn += std::string(1, letter) + "#100\r\n";
    put(folder + "/" + name + ".dat", dat);
    put(folder + "/" + name + ".art", art);
    put(folder + "/" + name + ".arn", arn);
    put(folder + "/" + name + ".inf", " 1 \r\n");
}

void writeCatalogue(const std::string& folder, const std::string& list) {
    put(folder + "/type.dat", "Types\r\nMusic CD\r\nDVD video\r\nGame\r\n");
    put(folder + "/information.dat", "Information\r\nOriginal\r\nCopy\r\n");
    put(folder + "/pemla.dat", list + "\r\n");
}

}  // namespace bench
