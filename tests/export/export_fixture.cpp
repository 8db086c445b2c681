#include "tests/export/export_fixture.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <fstream>
#include <iterator>

namespace export_test {

std::string data(const std::string& name) {
    std::ifstream in(std::string(PEMLA_EXPORT_DATA) + "/" + name, std::ios::binary);
    if (!in) throw std::runtime_error("missing test data " + name);
    return {std::istreambuf_iterator<char>(in), {}};
}

std::vector<std::string> movieTitles(bool withCasablanca) {
    std::vector<std::string> titles = {"Alien",
                                       "amelie",
                                       "Blade Runner",
                                       "Heat",
                                       "Star",
                                       "Star Wars",
                                       "The Lord of the Rings Trilogy",
                                       "Wars",
                                       "Zorro"};
    if (withCasablanca) titles.insert(titles.begin() + 3, "Casablanca");
    return titles;
}

std::string settings(const std::vector<std::string>& lines) {
    std::string text;
    for (const std::string& line : lines) text += line + "\r\n";
    return text;
}

ExportFixture::ExportFixture(std::vector<std::string> drives)
    : dialog(std::move(drives)), form(dialog.controls(), main.platform, main.store, *main.form) {
    if (const char* old = std::getenv("HOME")) oldHome_ = old;
    ::setenv("HOME", home.path().c_str(), 1);
    main.form->setDialogs({nullptr, &dialog.window, nullptr});
}

ExportFixture::~ExportFixture() {
    ::setenv("HOME", oldHome_.c_str(), 1);
}

void ExportFixture::openMovies(const std::string& flag) {
    main.putList("Movies", data("movies.dat"), data("movies.art"), "A#003\r\n", flag);
    main.folder.put("pemla.dat", "Movies\r\n");
    main.start();
    main.open("Movies");
}

void ExportFixture::openDialog() {
    ASSERT_TRUE(main.view.Command_export.click());
}

}  // namespace export_test
