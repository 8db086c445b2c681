#include "ui/platform.h"

namespace ui {

MessageStyle decodeStyle(int style) {
    MessageStyle decoded;
    decoded.buttons =
        (style & 7) == kYesNo ? MessageStyle::Buttons::YesNo : MessageStyle::Buttons::Ok;
    switch (style & 0x70) {
        case kCritical:
            decoded.icon = MessageStyle::Icon::Critical;
            break;
        case kQuestion:
            decoded.icon = MessageStyle::Icon::Question;
            break;
        case kExclamation:
            decoded.icon = MessageStyle::Icon::Exclamation;
            break;
        case kInformation:
            decoded.icon = MessageStyle::Icon::Information;
            break;
        default:
            decoded.icon = MessageStyle::Icon::None;
            break;
    }
    decoded.secondIsDefault = (style & 0x300) == kSecondDefault;
    return decoded;
}

}  // namespace ui
