#include "catalogue/entry_rules.h"

#include "catalogue/catalogue_error.h"
#include "catalogue/file_text.h"
#include "catalogue/latin1.h"
#include "catalogue/name_probe.h"

namespace catalogue {

std::string entryRefusal(const Entry& entry) {
    if (entry.title.empty()) return "Please type a title first.";
    const std::pair<const char*, const std::string*> fields[] = {
        {"The title", &entry.title},
        {"The type", &entry.type},
        {"The number of discs", &entry.discs},
        {"The information", &entry.information}};
    for (const auto& [label, value] : fields) {
        const std::string problem = valueProblem(*value, value == &entry.title);
        if (!problem.empty()) {
            return std::string(label) + " cannot hold " + problem +
                   ": the list's files use it to mark their records.";
        }
    }
    return {};
}

bool isDuplicateTitle(std::string_view entries, std::string_view title) {
    return findTitleLine(entries, title) != std::string_view::npos && title != " ";
}

std::optional<ArticleNumberResult> handOutNumber(std::string_view counterText,
                                                 const std::string& counterFile,
                                                 char firstCharacter, std::string& refusal) {
    const char letter = articleLetter(firstCharacter);
    switch (counterProblem(counterText, letter)) {
        case CounterProblem::Exhausted:
            refusal = std::string("Every article number of the letter ") + letter + " (" + letter +
                      "001 to " + letter +
                      "999) has been handed out in this list, so no other title that files "
                      "under this letter can be stored in it.";
            return std::nullopt;
        case CounterProblem::Damaged:
            throw CatalogueError(counterFile,
                                 std::string("the record of the letter ") + letter + " is damaged");
        case CounterProblem::None:
            break;
    }
    return nextArticleNumber(counterText, firstCharacter);
}

NewListCheck checkNewListName(Store& store, const std::string& name) {
    NewListCheck check;
    if (!probeFileName(store, name)) {
        check.refusal = kBadName;
        return check;
    }
    check.index = store.readText(kIndexFile);
    // Both tests match anywhere: a name that a listed name ends with, a trailing part of a
    // reserved word, and the empty name are all refused.
    const bool listed = findIgnoreCase(check.index, name + "\r") != std::string_view::npos;
    const bool reserved = findIgnoreCase(kReservedNames, name + "|") != std::string_view::npos;
    if (listed || reserved) {
        check.refusal = kNameInUse;
    } else if (splitLines(check.index).size() >= 32767) {
        // List-box rows are counted in 16 bits, so the catalogue holds at most 32767 lists.
        check.refusal = kCatalogueFull;
    }
    return check;
}

}  // namespace catalogue
