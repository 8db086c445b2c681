#pragma once

#include <string_view>

#include "catalogue/store.h"

// Whether a proposed list name can serve as the base name of the list's files.
namespace catalogue {

// The suffix of the short-lived file that tries a name out.
inline constexpr std::string_view kProbeSuffix = ".del";

// False for a name that is not a file name on every system the catalogue may travel to: one
// holding / \ : ? * < > " | or a control character (C0, DEL or C1), and the names "." and "..".
// The empty name passes; it is a matter for the caller.
bool isPortableName(std::string_view name);

// Tries `name` + ".del" as a file of the store's folder: a portable name whose probe file can be
// created exclusively and removed again is usable. A probe file that is already there proves the
// name usable and is never touched. The probe is recorded before it is made, so a start after a
// kill removes it. False on any refusal; throws CatalogueError only when the record cannot be
// written (a pending change that cannot be finished, a folder that takes no file).
bool probeFileName(Store& store, std::string_view name);

}  // namespace catalogue
