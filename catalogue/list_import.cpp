#include "catalogue/list_import.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <cstring>
#include <optional>

#include "catalogue/byte_scan.h"
#include "catalogue/catalogue_error.h"
#include "catalogue/csv.h"
#include "catalogue/entry_rules.h"
#include "catalogue/file_text.h"
#include "catalogue/latin1.h"
#include "catalogue/records.h"
#include "catalogue/title_set.h"

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

// What one look at a row's bytes tells: `stop` when the row holds a line break or the start of a
// record marker or of the article separator somewhere, so that Add might refuse its entry (most
// rows hold none of it, and those that do are left to entryRefusal() to judge); `high` when it
// holds a byte above 127, so that it reads differently as UTF-8 and as Latin-1.
ByteKinds rowKinds(std::string_view row) {
    return byteKinds<'\r', '\n', '<', '#'>(row);
}

// A text filled from its front: room for a row is made once, and its pieces are then copied in
// without the checks of one append each. The bytes past `used` are spare.
struct Filling {
    std::string text;
    std::size_t used = 0;

    char* room(std::size_t bytes) {
        if (text.size() < used + bytes) text.resize(std::max(text.size() * 2, used + bytes));
        return text.data() + used;
    }
    static char* put(char* to, std::string_view piece) {
        if (piece.empty()) return to;  // an empty field may have no bytes to point at
        std::memcpy(to, piece.data(), piece.size());
        return to + piece.size();
    }
    std::string done() && {
        text.resize(used);
        return std::move(text);
    }
};

// The list's texts as they grow row by row, and what the Add button's tests need.
struct Growing {
    // Takes in the titles of the list's entry text; false when it does not hold whole entries.
    bool takeTitles() {
        const std::string_view text(entries.text);
        std::size_t lines = 0;
        for (std::size_t at = 0; at < text.size(); ++lines) {
            const Line line = lineAt(text, at);
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
    // written straight into `entries`, and count only once the row is taken in.
    std::string addRow(const CsvReader& record) {
        if (record.unclosedQuote()) return "A quoted field is not closed before the file ends.";
        static constexpr std::array<std::string_view, 4> kLineStarts = {"<|?", "\r\n<|'", "\r\n<||",
                                                                        "\r\n<|*"};
        const ByteKinds kinds = rowKinds(record.raw());
        const bool decode = utf8 && kinds.high;
        std::array<std::string_view, 4> fields;
        std::size_t bytes = 20;  // the line starts and the last line end
        for (std::size_t k = 0; k < fields.size(); ++k) {
            if (column[k] && *column[k] < record.fields().size()) {
                fields[k] = record.fields()[*column[k]];
            }
            bytes += fields[k].size();  // decoding from UTF-8 only ever shortens a field
        }
        char* const out = entries.room(bytes);
        char* to = out;
        std::array<std::string_view, 4> values;
        for (std::size_t k = 0; k < kLineStarts.size(); ++k) {
            std::string_view raw = fields[k];
            to = Filling::put(to, kLineStarts[k]);
            if (decode) {
                char32_t outside = 0;
                decoded_.clear();
                if (!appendAsLatin1(decoded_, raw, &outside)) {
                    return std::string("The ") + kFieldNames[k] + " holds the character " +
                           codePoint(outside) +
                           ", which the list's files cannot store (they hold Latin-1 only).";
                }
                raw = decoded_;
            }
            values[k] = {to, raw.size()};
            to = Filling::put(to, raw);
            if (k == 0) titles.look(values[0]);
        }
        to = Filling::put(to, kCrLf);
        std::string refusal = takeIn(kinds.stop || values[0].empty(), values);
        if (refusal.empty()) entries.used += static_cast<std::size_t>(to - out);
        return refusal;
    }

    // Numbers and counts an entry whose lines are written; why Add refuses it instead. The
    // entry checks run only when the row may hold something they refuse.
    std::string takeIn(bool mayBeRefused, const std::array<std::string_view, 4>& values) {
        if (mayBeRefused) {
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
        char* to = articles.room(title.size() + kArticleSeparator.size() + 4 + kCrLf.size());
        to = Filling::put(to, title);
        to = Filling::put(to, kArticleSeparator);
        to = Filling::put(to, {number, 4});
        to = Filling::put(to, kCrLf);
        articles.used = static_cast<std::size_t>(to - articles.text.data());
        titles.add();
        ++count;
        return {};
    }

    std::array<std::optional<std::size_t>, 4> column;  // title, type, discs, information
    bool utf8 = false;
    Filling entries, articles;
    Counters counters;
    import_titles::TitleSet titles;
    std::size_t count = 0;

  private:
    std::string decoded_;  // a field of a UTF-8 row in Latin-1
};

}  // namespace

ImportResult importCsv(Store& store, const std::string& list, std::string_view csvBytes) {
    clearUpperVectorHalves();
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
        g.entries.text = toFileText(store.readBytes(entryFile(result.list)));
        g.entries.used = g.entries.text.size();
        if (!g.takeTitles()) {
            throw CatalogueError(entryFile(result.list), "the file ends inside an entry");
        }
        g.counters = Counters(store.readText(counterFile(result.list)), counterFile(result.list));
        g.articles.text = store.readTextIfExists(articleFile(result.list)).value_or("");
        g.articles.used = g.articles.text.size();
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
    g.entries.room(csvBytes.size() + csvBytes.size() / 2);
    g.articles.room(csvBytes.size() / 2);
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
    t.write(entryFile(result.list), std::move(g.entries).done());
    t.write(articleFile(result.list), std::move(g.articles).done());
    t.write(counterFile(result.list), g.counters.text());
    t.commit();
    return result;
}

}  // namespace catalogue
