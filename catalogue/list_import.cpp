#include "catalogue/list_import.h"

#include <array>
#include <cstdint>
#include <cstring>
#include <functional>
#include <optional>

#include "catalogue/byte_scan.h"
#include "catalogue/catalogue_error.h"
#include "catalogue/csv.h"
#include "catalogue/entry_rules.h"
#include "catalogue/file_text.h"
#include "catalogue/latin1.h"
#include "catalogue/records.h"

namespace catalogue {

namespace {

constexpr std::string_view kBom = "\xEF\xBB\xBF";
constexpr std::array<std::string_view, 4> kColumns = {"title", "type", "discs", "information"};
constexpr std::array<const char*, 4> kFieldNames = {"title", "type", "number of discs",
                                                    "information"};

std::string trimmed(std::string_view text) {
    const std::size_t first = text.find_first_not_of(" \t");
    if (first == std::string_view::npos) return {};
    return std::string(text.substr(first, text.find_last_not_of(" \t") - first + 1));
}

std::string codePoint(char32_t code) {
    char text[16];
    std::snprintf(text, sizeof text, "U+%04X", static_cast<unsigned>(code));
    return text;
}

// The index line naming `list` ignoring case, as the index spells it.
std::optional<std::string> listedName(std::string_view index, std::string_view list) {
    for (std::string_view line : splitLines(index)) {
        if (equalsIgnoreCase(line, list)) return std::string(line);
    }
    return std::nullopt;
}

// Latin-1 letter case folded by table: every title is folded once, byte by byte.
const std::array<char, 256> kFolded = [] {
    std::array<char, 256> table{};
    for (std::size_t c = 0; c < table.size(); ++c) {
        table[c] = static_cast<char>(foldByte(static_cast<unsigned char>(c)));
    }
    return table;
}();

// The titles of a list folded, each kept once in one text and found through open addressing,
// so that a title costs no allocation of its own. A slot is eight bytes (part of the hash, and
// which title), so the table of a full list stays in the processor's cache.
class TitleSet {
  public:
    // Room for `expected` titles without growing.
    void reserve(std::size_t expected) {
        std::size_t size = 1024;
        while (size < expected * 2) size *= 2;
        if (size > slots_.size()) rehash(size);
    }

    // Folds `title` and fetches its place in the table, which holds() then looks at: the fetch
    // goes on while the caller does other work.
    void look(std::string_view title) {
        if (slots_.empty()) rehash(1024);
        const std::size_t used = starts_.back();
        keys_.resize(used + title.size());
        char* const key = keys_.data() + used;
        for (std::size_t i = 0; i < title.size(); ++i) {
            key[i] = kFolded[static_cast<unsigned char>(title[i])];
        }
        length_ = title.size();
        tag_ = static_cast<std::uint32_t>(std::hash<std::string_view>{}({key, length_}));
        __builtin_prefetch(&slots_[tag_ & (slots_.size() - 1)]);
    }

    // Whether the set holds the title last given to look(), ignoring case. When it does not,
    // add() takes it in.
    bool holds() {
        const char* const key = keys_.data() + starts_.back();
        const std::size_t mask = slots_.size() - 1;
        for (slot_ = tag_ & mask; slots_[slot_] != 0; slot_ = (slot_ + 1) & mask) {
            const std::uint64_t s = slots_[slot_];
            if (s >> 32 != tag_) continue;
            const std::size_t other = (s & 0xFFFFFFFFu) - 1;
            const std::size_t start = starts_[other];
            if (starts_[other + 1] - start == length_ &&
                std::memcmp(keys_.data() + start, key, length_) == 0) {
                return true;
            }
        }
        return false;
    }

    // Takes in the title that holds() last looked for and did not find.
    void add() {
        // Titles are counted in 32 bits: a list's files would need far more memory than there
        // is to hold 2^32 of them.
        slots_[slot_] = std::uint64_t{tag_} << 32 | static_cast<std::uint32_t>(starts_.size());
        starts_.push_back(starts_.back() + length_);
        if (starts_.size() * 2 > slots_.size()) rehash(slots_.size() * 2);
    }

  private:
    void rehash(std::size_t size) {
        std::vector<std::uint64_t> old(size);
        old.swap(slots_);
        const std::size_t mask = size - 1;
        for (const std::uint64_t s : old) {
            if (s == 0) continue;
            std::size_t i = (s >> 32) & mask;
            while (slots_[i] != 0) i = (i + 1) & mask;
            slots_[i] = s;
        }
    }

    std::string keys_;  // the folded titles one after another, then the one looked for
    std::vector<std::size_t> starts_ = {0};  // where each title starts in keys_, and the end
    std::vector<std::uint64_t> slots_;       // hash << 32 | title + 1; 0 when free
    std::size_t slot_ = 0, length_ = 0;      // the title last looked for
    std::uint32_t tag_ = 0;
};

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
        const char letter = articleLetter(firstCharacter);
        Letter& l = letters_[letter == '!' ? 26 : letter - 'A'];
        if (l.state == State::Counting && l.next == 0) {
            flush();  // used up here: the text says so, and handOutNumber() words the refusal
            l.state = State::Unused;
        }
        if (l.state == State::Refused) {
            refusal = l.refusal;
            return false;
        }
        if (l.state == State::Unused) {
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
            l.next = (text_[l.digits] - '0') * 100 + (text_[l.digits + 1] - '0') * 10 +
                     (text_[l.digits + 2] - '0');
            l.state = State::Counting;
            return true;
        }
        number[0] = letter;
        writeDigits(number + 1, l.next);
        l.next = (l.next + 1) % 1000;  // 999 -> "000": used up
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
        int next = 0;
        std::string refusal;
    };

    static void writeDigits(char* to, int value) {
        to[0] = static_cast<char>('0' + value / 100);
        to[1] = static_cast<char>('0' + value / 10 % 10);
        to[2] = static_cast<char>('0' + value % 10);
    }

    // Writes the counted numbers into the text. Digits never hold a letter, so no record moves.
    void flush() {
        for (const Letter& l : letters_) {
            if (l.state == State::Counting) writeDigits(text_.data() + l.digits, l.next);
        }
    }

    std::string text_;
    std::string file_;
    std::array<Letter, 27> letters_;  // A to Z, then "!"
};

// Whether Add might refuse a row's entry: no title, or the row holds a line break or the start of
// a record marker or of the article separator somewhere. Most rows hold none of it, and those
// that do are left to entryRefusal() to judge.
bool mayBeRefused(std::string_view row, std::string_view title) {
    return title.empty() || findAnyOf<'\r', '\n', '<', '#'>(row) != row.size();
}

// The list's texts as they grow row by row, and what the Add button's tests need.
struct Growing {
    // Takes in the titles of the list's entry text; false when it does not hold whole entries.
    bool takeTitles() {
        std::size_t lines = 0;
        for (std::size_t at = 0; at < entries.size(); ++lines) {
            const Line line = lineAt(entries, at);
            if (lines % 4 == 0) {
                titles.look(line.text.substr(std::min<std::size_t>(3, line.text.size())));
                if (!titles.holds()) titles.add();
            }
            at = line.next;
        }
        count = lines / 4;
        return lines % 4 == 0;
    }

    // Adds the entry of one record; why not when it cannot be added. The entry's lines are
    // written straight into `entries`, and taken back should the row be refused.
    std::string addRow(const CsvReader& record) {
        if (record.unclosedQuote()) return "A quoted field is not closed before the file ends.";
        static constexpr std::array<std::string_view, 4> kLineStarts = {"<|?", "\r\n<|'", "\r\n<||",
                                                                        "\r\n<|*"};
        const std::size_t mark = entries.size();
        // A row without a byte above 127 reads the same as UTF-8 and as Latin-1.
        const bool decode = utf8 && !isAscii(record.raw());
        std::array<std::size_t, 4> start{}, length{};
        for (std::size_t k = 0; k < kLineStarts.size(); ++k) {
            std::string_view raw;
            if (column[k] && *column[k] < record.fields().size()) {
                raw = record.fields()[*column[k]];
            }
            entries.append(kLineStarts[k]);
            start[k] = entries.size();
            char32_t outside = 0;
            if (!decode) {
                entries.append(raw);
            } else if (!appendAsLatin1(entries, raw, &outside)) {
                entries.resize(mark);
                return std::string("The ") + kFieldNames[k] + " holds the character " +
                       codePoint(outside) +
                       ", which the list's files cannot store (they hold Latin-1 only).";
            }
            length[k] = entries.size() - start[k];
            if (k == 0) titles.look(std::string_view(entries).substr(start[0], length[0]));
        }
        entries.append(kCrLf);
        std::array<std::string_view, 4> values;
        for (std::size_t k = 0; k < values.size(); ++k) {
            values[k] = std::string_view(entries).substr(start[k], length[k]);
        }
        std::string refusal = takeIn(record.raw(), values);
        if (!refusal.empty()) entries.resize(mark);
        return refusal;
    }

    // Numbers and counts an entry whose lines are written; why Add refuses it instead.
    std::string takeIn(std::string_view row, const std::array<std::string_view, 4>& values) {
        if (mayBeRefused(row, values[0])) {
            std::string refusal = entryRefusal({std::string(values[0]), std::string(values[1]),
                                                std::string(values[2]), std::string(values[3])});
            if (!refusal.empty()) return refusal;
        }
        const std::string_view title = values[0];
        if (titles.holds() && title != " ") return kDuplicateTitle;
        if (count >= static_cast<std::size_t>(kMaxEntries)) return kListFull;
        char number[4];
        std::string refusal;
        if (!counters.handOut(title.front(), number, refusal)) return refusal;
        articles.append(title).append(kArticleSeparator).append(number, 4).append(kCrLf);
        titles.add();
        ++count;
        return {};
    }

    std::array<std::optional<std::size_t>, 4> column;  // title, type, discs, information
    bool utf8 = false;
    std::string entries, articles;
    Counters counters;
    TitleSet titles;
    std::size_t count = 0;
};

}  // namespace

ImportResult importCsv(Store& store, const std::string& list, std::string_view csvBytes) {
    ImportResult result;
    if (csvBytes.starts_with(kBom)) csvBytes.remove_prefix(kBom.size());
    CsvReader reader(csvBytes);
    if (!reader.next()) {
        result.problem = "The file holds no header row.";
        return result;
    }
    std::array<std::optional<std::size_t>, 4> column;
    for (std::size_t i = 0; i < reader.fields().size(); ++i) {
        const std::string name = trimmed(reader.fields()[i]);
        for (std::size_t k = 0; k < kColumns.size(); ++k) {
            if (!column[k] && equalsIgnoreCase(name, kColumns[k])) column[k] = i;
        }
    }
    if (!column[0]) {
        result.problem = "The header row (line " + std::to_string(reader.line()) +
                         ") names no \"title\" column.";
        return result;
    }

    const std::string index = store.readText(kIndexFile);
    Growing g;
    g.column = column;
    if (std::optional<std::string> name = listedName(index, list)) {
        result.list = *name;
        g.entries = toFileText(store.readBytes(entryFile(result.list)));
        if (!g.takeTitles()) {
            throw CatalogueError(entryFile(result.list), "the file ends inside an entry");
        }
        g.counters = Counters(store.readText(counterFile(result.list)), counterFile(result.list));
        g.articles = forWriting(store.readTextIfExists(articleFile(result.list)).value_or(""));
    } else {
        const NewListCheck check = checkNewListName(store, list);
        const std::string refusal = list.size() > static_cast<std::size_t>(kMaxNameLength)
                                        ? "A list name holds at most 26 characters."
                                        : check.refusal;
        if (!refusal.empty()) {
            result.problem = "The list \"" + list + "\" cannot be created: " + refusal;
            return result;
        }
        result.list = list;
        result.created = true;
        g.counters = Counters({}, counterFile(list));
    }
    g.utf8 = isUtf8(csvBytes);

    // A row's lines take its fields and about twenty bytes more; rows are rarely shorter than 40.
    g.titles.reserve(std::min(g.count + csvBytes.size() / 16, std::size_t{kMaxEntries}));
    g.entries.reserve(g.entries.size() + csvBytes.size() + csvBytes.size() / 2);
    g.articles.reserve(g.articles.size() + csvBytes.size() / 2);
    while (reader.next()) {
        std::string refusal = g.addRow(reader);
        if (refusal.empty()) {
            ++result.added;
        } else {
            result.refused.push_back({reader.line(), std::move(refusal)});
        }
    }
    if (result.added == 0) {
        result.created = false;
        return result;
    }

    Transaction t = store.begin();
    if (result.created) {
        t.write(kIndexFile, forWriting(index) + list + "\r\n");
        t.write(flagFile(list), fileNumber(1));
    }
    t.write(entryFile(result.list), g.entries);
    t.write(articleFile(result.list), g.articles);
    t.write(counterFile(result.list), g.counters.text());
    t.commit();
    return result;
}

}  // namespace catalogue
