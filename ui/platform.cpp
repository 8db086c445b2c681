#include "ui/platform.h"

namespace ui {

MessageStyle decodeStyle(int style) {
    MessageStyle decoded;
    decoded.buttons = (style & 7) == 4 ? MessageStyle::Buttons::YesNo : MessageStyle::Buttons::Ok;
    switch (style & 0x70) {
        case 16:
            decoded.icon = MessageStyle::Icon::Critical;
            break;
        case 32:
            decoded.icon = MessageStyle::Icon::Question;
            break;
        case 48:
            decoded.icon = MessageStyle::Icon::Exclamation;
            break;
        case 64:
            decoded.icon = MessageStyle::Icon::Information;
            break;
        default:
            decoded.icon = MessageStyle::Icon::None;
            break;
    }
    decoded.secondIsDefault = (style & 0x300) == 256;
    return decoded;
}

}  // namespace ui
