#include "tests/export/export_fixture.h"

#include <cstdlib>
#include <fstream>
#include <iterator>

namespace export_test {

std::string data(const std::string& name) {
    std::ifstream in(std::string(PEMLA_EXPORT_DATA) + "/" + name, std::ios::binary);
    if (!in) throw std::runtime_error("missing test data " + name);
    return {std::istreambuf_iterator<char>(in), {}};
}

ExportFixture::ExportFixture() {
    if (const char* old = std::getenv("HOME")) oldHome_ = old;
    ::setenv("HOME", home.path().c_str(), 1);
}

ExportFixture::~ExportFixture() {
    ::setenv("HOME", oldHome_.c_str(), 1);
}

void ExportFixture::openMovies(const std::string& flag) {
    main.folder.putList("Movies", data("movies.dat"), data("movies.art"), "A#003\r\n", flag);
    main.folder.put("pemla.dat", "Movies\r\n");
    main.start();
    main.open("Movies");
}

}  // namespace export_test
