#pragma once

#include <stdexcept>
#include <string>

namespace catalogue {

// The one error type of the catalogue: which file, and why (usually the OS reason from strerror).
// Window handlers catch it and show both to the user; the catalogue itself never shows anything.
class CatalogueError : public std::runtime_error {
  public:
    CatalogueError(std::string file, std::string reason);

    const std::string& file() const { return file_; }
    const std::string& reason() const { return reason_; }

  private:
    std::string file_;
    std::string reason_;
};

// Builds an error for `file` from an errno value.
CatalogueError osError(const std::string& file, int errnum);

}  // namespace catalogue
