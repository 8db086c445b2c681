#pragma once

#include "tests/support/memory_form1.h"

// The fault tests work on the windows over a catalogue folder, every call through a FaultySys.
namespace faults {

using Rig = test_support::MainWindowFixture;
using test_support::crlf;
using test_support::difference;
using test_support::entryText;
using test_support::Files;
using test_support::hasLeftovers;
using test_support::inChild;
using test_support::killed;
using test_support::snapshot;

// "Abba Gold", the one entry of the list "Rock" that most tests start from.
inline const std::string kAbbaDat = entryText({{"Abba Gold", "Music CD", "1", "Original"}});

}  // namespace faults
