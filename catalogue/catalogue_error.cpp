#include "catalogue/catalogue_error.h"

#include <cstring>

namespace catalogue {

CatalogueError::CatalogueError(std::string file, std::string reason)
    : std::runtime_error(file + ": " + reason),
      file_(std::move(file)),
      reason_(std::move(reason)) {}

CatalogueError osError(const std::string& file, int errnum) {
    return CatalogueError(file, std::strerror(errnum));
}

}  // namespace catalogue
