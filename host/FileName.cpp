#include "host/FileName.h"

#include "text/Format.h"

namespace pallax {

std::string fileNameFor(std::string_view name) {
    constexpr std::string_view kPlain =
        "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789-_.";
    std::string result;
    for (const char character : name) {
        const bool leadingDot = character == '.' && result.empty();
        if (kPlain.find(character) != std::string_view::npos && !leadingDot) {
            result += character;
        } else {
            result += formatText("%%%02X", {static_cast<unsigned char>(character)});
        }
    }
    return result;
}

} // namespace pallax
