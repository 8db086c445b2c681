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
#include "catalogue/import_numbers.h"
#include "catalogue/latin1.h"
#include "catalogue/records.h"
#include "catalogue/title_set.h"
#include "catalogue/utf8.h"

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

// What one look at a row's bytes tells: `stop` when the row holds a line break or the start of a
// record marker or of the article separator somewhere, so that Add might refuse its entry (most
// rows hold none of it, and those that do are left to entryRefusal() to judge); `high` when it
// holds a byte above 127, so that it reads differently as UTF-8 and as Latin-1.
ByteKinds rowKinds(std::string_view row) {
    return byteKinds<'\r', '\n', '<', '#'>(row);
}

// Bytes that may be read sixteen at a time from any place up to sixteen before their end.
struct Readable {
    std::uintptr_t begin = 0;
    std::size_t places = 0;  // how many places a sixteen-byte read may start at

    explicit Readable(std::string_view bytes)
        : begin(reinterpret_cast<std::uintptr_t>(bytes.data())),
          places(bytes.size() >= 16 ? bytes.size() - 15 : 0) {}
    bool holds16(const char* at) const {
        return reinterpret_cast<std::uintptr_t>(at) - begin < places;  // unsigned: also below
    }
};

// A text filled from its front: room for a row is made once, and its pieces are then copied in
// without the checks of one append each. The bytes past `used` are spare.
struct Filling {
    // A short piece is copied sixteen bytes at once; the room keeps that many spare past it.
    static constexpr std::size_t kSpare = 16;

    std::string text;
    std::size_t used = 0;

    char* room(std::size_t bytes) {
        if (text.size() - used < bytes + kSpare) grow(bytes + kSpare);
        return text.data() + used;
    }
    // Within the capacity reserved, the text is lengthened a stretch at a time, so that room
    // reserved and never needed is never written.
    [[gnu::noinline]] void grow(std::size_t bytes) {
        const std::size_t needed = used + bytes;
        if (needed > text.capacity()) text.reserve(std::max(needed, text.capacity() * 2));
        text.resize(std::max(needed, std::min(text.capacity(), text.size() + 65536)));
    }
    // Copies a piece to `to`. One of up to sixteen bytes in `from` is copied in one move, which
    // writes up to sixteen bytes past it into the spare room.
    static char* put(char* to, std::string_view piece, const Readable& from) {
        const std::size_t size = piece.size();
        if (size <= 16 && from.holds16(piece.data())) {
            std::memcpy(to, piece.data(), 16);
        } else if (size > 0) {  // an empty field may have no bytes to point at
            std::memcpy(to, piece.data(), size);
        }
        return to + size;
    }
    template <std::size_t N>
    static char* put(char* to, const char (&bytes)[N]) {
        std::memcpy(to, bytes, N - 1);
        return to + N - 1;
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
            const std::size_t cr = findAnyOf<'\r'>(text, at);
            if (lines % 4 == 0) {
                const std::size_t from = std::min(at + 3, cr);
                titles.look(text.substr(from, cr - from), from + 16 <= text.size());
                if (!titles.holds(text)) titles.add(from);
            }
            at = cr + 1;
            if (at < text.size() && text[at] == '\n') ++at;
        }
        count = lines / 4;
        return lines % 4 == 0;
    }

    // Adds the entry of one record; why not when it cannot be added. The entry's lines are
    // written straight into `entries`, and count only once the row is taken in.
    std::string addRow(const CsvReader& record) {
        if (record.unclosedQuote()) return "A quoted field is not closed before the file ends.";
        const ByteKinds kinds = rowKinds(record.raw());
        const bool decode = utf8 && kinds.high;
        // The fields are read through pointers, a word at a time: a view the reader has just
        // stored in two words cannot be handed on to a load of both at once, which waits.
        static constexpr std::string_view kNone;
        const std::vector<std::string_view>& all = record.fields();
        std::array<const std::string_view*, 4> fields;
        std::size_t bytes = 20;  // the line starts and the last line end
        for (std::size_t k = 0; k < fields.size(); ++k) {
            fields[k] = column[k] < all.size() ? &all[column[k]] : &kNone;
            bytes += fields[k]->size();  // decoding from UTF-8 only ever shortens a field
        }
        // A title stored as it stands in the row is hashed there, so that its place in the
        // table is fetched while the row is copied.
        if (!decode) titles.look(*fields[0], csv.holds16(fields[0]->data()));
        char* to = entries.room(bytes);
        std::array<std::string_view, 4> values;
        std::size_t failed = 0;  // the first field with a character Latin-1 cannot hold, from 1
        char32_t outside = 0;
        // Each field as it stands in the row, or from UTF-8 when the row reads differently so.
        auto field = [&](std::size_t k) {
            char* const start = to;
            if (decode) {
                char32_t code = 0;
                to = writeAsLatin1(to, *fields[k], &code);
                if (to == nullptr) {
                    if (failed == 0) {
                        failed = k + 1;
                        outside = code;
                    }
                    to = start;
                }
            } else {
                to = Filling::put(to, *fields[k], csv);
            }
            values[k] = {start, static_cast<std::size_t>(to - start)};
        };
        to = Filling::put(to, "<|?");
        field(0);
        to = Filling::put(to, "\r\n<|'");
        field(1);
        to = Filling::put(to, "\r\n<||");
        field(2);
        to = Filling::put(to, "\r\n<|*");
        field(3);
        to = Filling::put(to, "\r\n");
        if (failed != 0) {
            return std::string("The ") + kFieldNames[failed - 1] + " holds the character " +
                   codePoint(outside) +
                   ", which the list's files cannot store (they hold Latin-1 only).";
        }
        if (decode) titles.look(values[0], Readable(entries.text).holds16(values[0].data()));
        // The article line takes its title from the file where it stands there: bytes just
        // stored into the entry text would be read back before they are written out.
        std::string refusal =
            takeIn(kinds.stop || values[0].empty(), values, decode ? values[0] : *fields[0],
                   decode ? Readable(entries.text) : csv);
        if (refusal.empty()) entries.used = static_cast<std::size_t>(to - entries.text.data());
        return refusal;
    }

    // Numbers and counts an entry whose lines are written; why Add refuses it instead. The
    // entry checks run only when the row may hold something they refuse.
    std::string takeIn(bool mayBeRefused, const std::array<std::string_view, 4>& values,
                       std::string_view titleBytes, const Readable& titleIn) {
        if (mayBeRefused) {
            std::string refusal = entryRefusal({std::string(values[0]), std::string(values[1]),
                                                std::string(values[2]), std::string(values[3])});
            if (!refusal.empty()) return refusal;
        }
        const std::string_view title = values[0];
        if (titles.holds(entries.text) && title != " ") return kDuplicateTitle;
        if (count >= static_cast<std::size_t>(kMaxEntries)) return kListFull;
        char number[4];
        std::string refusal;
        if (!counters.handOut(title.front(), number, refusal)) return refusal;
        char* to = articles.room(title.size() + kArticleSeparator.size() + 4 + kCrLf.size());
        to = Filling::put(to, titleBytes, titleIn);
        to = Filling::put(to, "#*\\");
        std::memcpy(to, number, 4);
        to = Filling::put(to + 4, "\r\n");
        articles.used = static_cast<std::size_t>(to - articles.text.data());
        titles.add(static_cast<std::size_t>(title.data() - entries.text.data()));
        ++count;
        return {};
    }

    // Where the title, type, discs and information stand in a record; npos for none.
    std::array<std::size_t, 4> column;
    bool utf8 = false;
    Readable csv{{}};  // the CSV file's bytes, which the fields are read from
    Filling entries, articles;
    import_numbers::Counters counters;
    import_titles::TitleSet titles;
    std::size_t count = 0;
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
    for (std::size_t k = 0; k < column.size(); ++k) {
        g.column[k] = column[k].value_or(std::string_view::npos);
    }
    if (std::optional<std::string> name = listedName(index, list)) {
        result.list = *name;
        g.entries.text = toFileText(store.readBytes(entryFile(result.list)));
        g.entries.used = g.entries.text.size();
        if (!g.takeTitles()) {
            throw CatalogueError(entryFile(result.list), "the file ends inside an entry");
        }
        g.counters = import_numbers::Counters(store.readText(counterFile(result.list)),
                                              counterFile(result.list));
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
        g.counters = import_numbers::Counters({}, counterFile(list));
    }
    g.utf8 = isUtf8(csvBytes);

    g.csv = Readable(csvBytes);

    // The rows' fields are parts of the file, and a row's lines take twenty bytes more: with
    // room for every row the list can take, the entry text is never moved while it fills.
    const std::size_t rows = static_cast<std::size_t>(kMaxEntries) + 1 -
                             std::min(g.count, static_cast<std::size_t>(kMaxEntries));
    g.titles.reserve(std::min(g.count + csvBytes.size() / 16, std::size_t{kMaxEntries}));
    g.entries.text.reserve(g.entries.used + csvBytes.size() + 20 * rows + Filling::kSpare);
    g.articles.text.reserve(g.articles.used + csvBytes.size() / 4 * 3 +
                            9 * std::min(rows, csvBytes.size() / 4));
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
