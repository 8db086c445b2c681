// Any bytes as the export dialog's settings file: every value is read or defaulted, and what is
// read is written back so that it reads the same again.
#include <cstdint>
#include <cstdlib>
#include <string>

#include "export/export_settings.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string bytes(reinterpret_cast<const char*>(data), size);
    const auto settings = exporting::decodeSettings(bytes);
    for (int check : settings.checks) {
        if (check < 0 || check > 2) std::abort();
    }
    const auto again = exporting::decodeSettings(exporting::encodeSettings(settings));
    if (again.folder != settings.folder || again.checks != settings.checks ||
        again.amount != settings.amount || again.position != settings.position) {
        std::abort();
    }
    return 0;
}
