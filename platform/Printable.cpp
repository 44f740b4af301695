#include "platform/Printable.h"

#include "platform/Utf8.h"

#include <algorithm>

namespace pallax {

namespace {

bool isControl(char32_t codePoint) {
    return codePoint < 0x20 || (codePoint >= 0x7F && codePoint < 0xA0);
}

template <class Replaced>
void appendCharacters(std::string& out, std::string_view text, Replaced replaced) {
    for (std::size_t at = 0; at < text.size();) {
        const Utf8CodePoint character = utf8At(text, at);
        const bool kept = character.size > 0 && !replaced(character.value);
        out += kept ? text.substr(at, character.size) : kReplacementCharacter;
        at += std::max<std::size_t>(character.size, 1);
    }
}

} // namespace

void appendValidUtf8(std::string& out, std::string_view text) {
    appendCharacters(out, text, [](char32_t /*codePoint*/) { return false; });
}

void appendPrintable(std::string& out, std::string_view text) {
    appendCharacters(out, text, isControl);
}

void appendPrintableLines(std::string& out, std::string_view text) {
    appendCharacters(out, text, [](char32_t codePoint) {
        return isControl(codePoint) && codePoint != '\n' && codePoint != '\t';
    });
}

} // namespace pallax
