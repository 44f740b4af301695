#pragma once

#include <string_view>

namespace pallax {

/// Throws a Refusal for faults that the XML parser would silently accept: invalid UTF-8, control
/// characters, a declared encoding other than UTF-8, a document type with declarations, entities
/// beyond the five of XML, and references to characters that XML cannot represent. Offsets are
/// counted from the start of `xml`.
void checkXmlMarkup(std::string_view xml);

/// Whether XML can represent the code point; below a space only tab, LF and CR.
constexpr bool isXmlCharacter(char32_t codePoint) {
    return codePoint >= U' ' || codePoint == U'\t' || codePoint == U'\n' || codePoint == U'\r';
}

} // namespace pallax
