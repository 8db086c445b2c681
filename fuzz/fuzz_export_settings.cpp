// Any bytes as the export dialog's settings file: read or refused, and what is read is written
// back so that it reads the same again.
#include <cstdint>
#include <cstdlib>
#include <string>

#include "export/export_settings.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string bytes(reinterpret_cast<const char*>(data), size);
    const auto settings = exporting::decodeSettings(bytes);
    if (!settings) return 0;
    for (int check : settings->checks) {
        if (check < 0 || check > 2) std::abort();
    }
    // Values holding a quote, or a line break, cannot be stored; the rest must round-trip.
    for (const std::string* value : {&settings->folder, &settings->amount, &settings->position}) {
        if (value->find_first_of("\"\r\n") != std::string::npos) return 0;
    }
    const auto again = exporting::decodeSettings(exporting::encodeSettings(*settings));
    if (!again || again->folder != settings->folder || again->checks != settings->checks ||
        again->amount != settings->amount || again->position != settings->position) {
        std::abort();
    }
    return 0;
}
