#include <QApplication>
#include <QFont>

#include "app/main_window_view.h"
#include "app/new_list_view.h"
#include "app/search_view.h"
#include "catalogue/store.h"
#include "main_window/form1.h"
#include "ui/qt/qt_platform.h"

// The program works on the catalogue in its working folder.
int main(int argc, char* argv[]) {
    QApplication application(argc, argv);
    QApplication::setApplicationName(QStringLiteral("pemla"));
    QApplication::setFont(QFont(QStringLiteral("DejaVu Sans"), 9));

    catalogue::Store store(".");
    ui::qt::QtPlatform platform;
    app::MainWindowView mainView;
    main_window::Form1 form1(mainView.controls(), platform, store);
    app::NewListView newListView(mainView.widget());
    new_list::Form_new_list formNewList(newListView.controls(), platform, store, form1);
    app::SearchView searchView(mainView.widget());
    search::Form_searchart formSearchart(searchView.controls(), platform, store, form1);
    form1.setDialogs({.newList = &newListView.controls().window,
                      .exporter = nullptr,
                      .search = &searchView.controls().window});

    mainView.controls().window.show();
    if (platform.ended()) return platform.status();
    return QApplication::exec();
}
