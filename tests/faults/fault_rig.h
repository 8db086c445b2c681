#pragma once

#include "tests/support/memory_form1.h"

// The fault tests work on the windows over a catalogue folder, every call through a FaultySys.
namespace faults {

using namespace test_support;  // the fault tests speak of folders, files and failing calls only
using Rig = MainWindowFixture;

// "Abba Gold", the one entry of the list "Rock" that most tests start from.
inline const std::string kAbbaDat = entryText({{"Abba Gold", "Music CD", "1", "Original"}});

}  // namespace faults
