#pragma once

#include <string>

// Realistic generated catalogues for the benchmark, and for the tests of a list at its largest.
namespace bench {

// A list of `entries` titles with every first letter in use (digits and accents too), its article
// and counter files consistent with how the program hands out numbers, and flag " 1 ".
void writeList(const std::string& folder, const std::string& name, int entries);

// The suggestion files and an index naming `list`.
void writeCatalogue(const std::string& folder, const std::string& list);

}  // namespace bench
