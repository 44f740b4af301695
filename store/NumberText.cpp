#include "store/NumberText.h"

#include "text/NumberFormat.h"

namespace pallax {

std::string printfText(const NumberFormat& format) {
    const NumberConversion& conversion = format.conversion();
    std::string text(format.prefix());
    text += '%';
    text.append(conversion.leftAlign ? "-" : "").append(conversion.plusSign ? "+" : "");
    text.append(conversion.zeroPad ? "0" : "").append(conversion.blankSign ? " " : "");
    text.append(conversion.alternate ? "#" : "");
    if (conversion.width > 0) {
        text += std::to_string(conversion.width);
    }
    if (conversion.precision >= 0) {
        text.append(".").append(std::to_string(conversion.precision));
    }
    text.append(conversion.wide ? "ll" : "").append(1, conversion.conversion);
    return text.append(format.suffix());
}

} // namespace pallax
