#include "app/program.h"

namespace app {

Program::Program(const std::string& folder, ui::qt::QtPlatform& platform)
    : store_(folder),
      platform_(platform),
      form1_(mainView_.controls(), platform_, store_),
      finder_(form1_),
      newListView_(mainView_.widget()),
      formNewList_(newListView_.controls(), platform_, store_, form1_),
      searchView_(mainView_.widget()),
      formSearchart_(searchView_.controls(), platform_, store_, form1_),
      exportView_(mainView_.widget()),
      formExport_(exportView_.controls(), platform_, store_, form1_) {
    mainView_.connectFinder(finder_);
    form1_.setDialogs({.newList = &newListView_.controls().window,
                       .exporter = &exportView_.controls().window,
                       .search = &searchView_.controls().window});
}

// The dialogs go before the main window they are kept above (members end in reverse order).
Program::~Program() = default;

void Program::start() {
    mainView_.controls().window.show();
}

}  // namespace app
