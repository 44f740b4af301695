#include "sources/modem/ShownText.h"

#include "text/Printable.h"

namespace pallax {

namespace {

constexpr std::string_view kEllipsis = "…";

/// Whether the byte continues a character.
bool continues(char byte) {
    constexpr unsigned kMask = 0xC0;
    constexpr unsigned kContinuation = 0x80;
    return (static_cast<unsigned char>(byte) & kMask) == kContinuation;
}

} // namespace

std::string shownText(std::string_view text) {
    const bool isLong = text.size() > kLongestShown;
    std::size_t length = isLong ? kLongestShown - kEllipsis.size() : text.size();
    while (isLong && length > 0 && continues(text[length])) {
        --length;
    }
    std::string shown;
    appendValidUtf8(shown, text.substr(0, length));
    return isLong ? shown.append(kEllipsis) : shown;
}

} // namespace pallax
