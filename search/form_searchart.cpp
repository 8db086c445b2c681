#include "search/form_searchart.h"

#include "catalogue/catalogue_error.h"
#include "catalogue/latin1.h"
#include "catalogue/records.h"

namespace search {

std::optional<std::string> titleBefore(std::string_view articleText, std::string_view number) {
    // An empty number would "occur" before the first line; it names no article.
    if (number.empty()) return std::nullopt;
    const std::size_t match = catalogue::findIgnoreCase(articleText, number);
    if (match == std::string_view::npos) return std::nullopt;
    std::size_t lineStart = 0;
    if (match > 0) {
        const std::size_t lf = articleText.rfind('\n', match - 1);
        if (lf != std::string_view::npos) lineStart = lf + 1;
    }
    // An article line is title + "#*\" + number, so a title ends three characters before its
    // number. A match that begins sooner in its line has no title in front of it: it shows
    // nothing, as one beginning at the fourth character does.
    const std::size_t into = match - lineStart;
    const std::size_t length = into > 3 ? into - 3 : 0;
    return std::string(articleText.substr(lineStart, length));
}

Form_searchart::Form_searchart(const Form_searchartControls& controls, ui::Platform& platform,
                               catalogue::Store& store, main_window::MainWindowLink& main)
    : MainWindowDialog(controls.window, main), c_(controls), platform_(platform), store_(store) {
    c_.window.setCaption(kSearchCaption);
    c_.Text1.setMaxLength(4);
    c_.Label1.setCaption(kSearchHint);
    c_.Command_search.setCaption("Search");
    c_.Command_cancel.setCaption("Cancel");

    c_.Command_search.onClick = [this] { Command_search_Click(); };
    c_.Command_cancel.onClick = [this] { Command_cancel_Click(); };
}

void Form_searchart::Form_Load() {
    c_.Text1.setText("");
    c_.Text2.setText("");
    c_.Text1.setFocus();
    try {
        ArticleText = "\r\n" + store_.readText(catalogue::articleFile(main_.selectedList()));
    } catch (const catalogue::CatalogueError& error) {
        ArticleText.clear();
        main_.showError(error.file(), error.reason());
        c_.window.unload();
    }
}

void Form_searchart::Form_Unload() {
    ArticleText.clear();
}

void Form_searchart::Command_search_Click() {
    const std::optional<std::string> title = titleBefore(ArticleText, c_.Text1.text());
    if (!title) {
        platform_.messageBox(kNotFound, ui::kCritical, "Error");
        return;
    }
    c_.Text2.setText(*title);
}

void Form_searchart::Command_cancel_Click() {
    c_.window.unload();
}

}  // namespace search
