#include "catalogue/list_import.h"

#include <array>
#include <optional>
#include <unordered_set>

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

std::string folded(std::string_view text) {
    std::string key(text);
    for (char& c : key) c = static_cast<char>(foldByte(static_cast<unsigned char>(c)));
    return key;
}

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

// The list's texts as they grow row by row, and what the Add button's tests need.
struct Growing {
    std::string entries, articles, counter;
    std::unordered_set<std::string> titles;  // folded
    std::size_t count = 0;
};

// Why a row cannot be added; empty when it was added to `list`.
std::string addRow(Growing& g, const std::string& list, const Entry& entry) {
    if (std::string refusal = entryRefusal(entry); !refusal.empty()) return refusal;
    const std::string key = folded(entry.title);
    if (g.titles.contains(key) && entry.title != " ") return kDuplicateTitle;
    if (g.count >= static_cast<std::size_t>(kMaxEntries)) return kListFull;
    std::string refusal;
    std::optional<ArticleNumberResult> next =
        handOutNumber(g.counter, counterFile(list), entry.title.front(), refusal);
    if (!next) return refusal;
    g.counter = std::move(next->counterText);
    g.entries += entryLines(entry);
    g.articles += articleLine(entry.title, next->number);
    g.titles.insert(key);
    ++g.count;
    return {};
}

}  // namespace

ImportResult importCsv(Store& store, const std::string& list, std::string_view csvBytes) {
    ImportResult result;
    if (csvBytes.starts_with(kBom)) csvBytes.remove_prefix(kBom.size());
    const bool utf8 = isUtf8(csvBytes);
    const std::vector<CsvRecord> records = parseCsv(csvBytes);
    if (records.empty()) {
        result.problem = "The file holds no header row.";
        return result;
    }
    std::array<std::optional<std::size_t>, 4> column;
    for (std::size_t i = 0; i < records.front().fields.size(); ++i) {
        const std::string name = trimmed(records.front().fields[i]);
        for (std::size_t k = 0; k < kColumns.size(); ++k) {
            if (!column[k] && equalsIgnoreCase(name, kColumns[k])) column[k] = i;
        }
    }
    if (!column[0]) {
        result.problem = "The header row (line " + std::to_string(records.front().line) +
                         ") names no \"title\" column.";
        return result;
    }

    Growing g;
    const std::string index = store.readText(kIndexFile);
    if (std::optional<std::string> name = listedName(index, list)) {
        result.list = *name;
        const std::string file = entryFile(result.list);
        const std::string bytes = store.readBytes(file);
        std::optional<std::vector<std::string>> titles = entryTitles(bytes);
        if (!titles) throw CatalogueError(file, "the file ends inside an entry");
        for (const std::string& title : *titles) g.titles.insert(folded(title));
        g.count = titles->size();
        g.entries = toFileText(bytes);
        g.counter = store.readText(counterFile(result.list));
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
    }

    g.titles.reserve(g.count + records.size());
    g.entries.reserve(g.entries.size() + csvBytes.size() + records.size() * 12);
    for (std::size_t r = 1; r < records.size(); ++r) {
        const CsvRecord& record = records[r];
        std::array<std::string, 4> values;
        std::string refusal;
        if (record.unclosedQuote) refusal = "A quoted field is not closed before the file ends.";
        for (std::size_t k = 0; k < values.size() && refusal.empty(); ++k) {
            if (!column[k] || *column[k] >= record.fields.size()) continue;
            const std::string& raw = record.fields[*column[k]];
            char32_t outside = 0;
            std::optional<std::string> value = utf8 ? utf8ToLatin1(raw, &outside) : raw;
            if (!value) {
                refusal = std::string("The ") + kFieldNames[k] + " holds the character " +
                          codePoint(outside) +
                          ", which the list's files cannot store (they hold Latin-1 only).";
            } else {
                values[k] = std::move(*value);
            }
        }
        if (refusal.empty())
            refusal = addRow(g, result.list, {values[0], values[1], values[2], values[3]});
        if (refusal.empty()) {
            ++result.added;
        } else {
            result.refused.push_back({record.line, std::move(refusal)});
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
    t.write(counterFile(result.list), g.counter);
    t.commit();
    return result;
}

}  // namespace catalogue
