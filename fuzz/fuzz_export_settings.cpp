// Any bytes as the export dialog's settings file: every value is read or defaulted, and what is
// read is written back so that it reads the same again.
#include "export/export_settings.h"
#include "fuzz/fuzz_target.h"

void fuzzOne(const std::string& bytes) {
    const auto settings = exporting::decodeSettings(bytes);
    for (int value : settings.checks) check(value >= 0 && value <= 2);
    const auto again = exporting::decodeSettings(exporting::encodeSettings(settings));
    check(again.folder == settings.folder && again.checks == settings.checks &&
          again.amount == settings.amount && again.position == settings.position);
}
