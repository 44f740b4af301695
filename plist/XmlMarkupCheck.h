#pragma once

#include <string_view>

namespace pallax {

/// Throws a Refusal at what the XML parser would pass over in silence: bytes that are no UTF-8,
/// control characters, a declared encoding other than UTF-8, a document type with declarations of
/// its own, entities beyond the five of XML, and references to characters that XML cannot hold.
/// Offsets are counted from the start of `xml`.
void checkXmlMarkup(std::string_view xml);

/// Whether XML can hold the code point; what lies below a space is only tab, LF and CR.
constexpr bool isXmlCharacter(char32_t codePoint) {
    return codePoint >= U' ' || codePoint == U'\t' || codePoint == U'\n' || codePoint == U'\r';
}

} // namespace pallax
