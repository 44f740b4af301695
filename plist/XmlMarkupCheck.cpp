#include "plist/XmlMarkupCheck.h"

#include "plist/Refusal.h"
#include "text/Utf8.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cstdint>

namespace pallax {

namespace {

constexpr std::string_view kUtf16BigEndianMark = "\xFE\xFF";
constexpr std::string_view kUtf16LittleEndianMark = "\xFF\xFE";
constexpr auto kEntities = std::to_array<std::string_view>({"amp", "lt", "gt", "quot", "apos"});

/// A printable ASCII character, a newline or a tab.
constexpr bool needsNoCheck(char letter) {
    return (letter >= ' ' && letter <= '~') || letter == '\n' || letter == '\t';
}

void checkCharacters(std::string_view xml) {
    if (xml.starts_with(kUtf16BigEndianMark) || xml.starts_with(kUtf16LittleEndianMark)) {
        refuse(0, "UTF-16, where only UTF-8 is read");
    }
    for (std::size_t at = 0; at < xml.size();) {
        if (needsNoCheck(xml[at])) { // the usual case; utf8At took half of the check's time
            ++at;
            continue;
        }
        const Utf8CodePoint next = utf8At(xml, at);
        if (next.size == 0) {
            refuse(at, "a byte that is no UTF-8");
        }
        if (!isXmlCharacter(next.value)) {
            refuse(at, "a control character that XML cannot hold");
        }
        at += next.size;
    }
}

/// The content of a "&#…;" without "&#" and ";", or a refusal.
void checkCharacterReference(std::size_t offset, std::string_view digits) {
    const bool hexadecimal = digits.starts_with('x');
    digits.remove_prefix(hexadecimal ? 1 : 0);
    std::uint32_t number = 0;
    const auto [end, error] = std::from_chars(digits.data(), digits.data() + digits.size(), number,
                                              hexadecimal ? 16 : 10);
    if (error == std::errc::invalid_argument || end != digits.data() + digits.size()) {
        refuse(offset, "a character reference that is no number");
    }
    if (error != std::errc() || number > kLastCodePoint || isSurrogate(number) ||
        !isXmlCharacter(number)) {
        refuse(offset, "a reference to a character that XML cannot hold");
    }
}

/// Checks the reference whose "&" is at `at`; returns its end.
std::size_t checkReference(std::string_view xml, std::size_t at) {
    const std::size_t end = xml.find_first_of(";&<> \t\r\n\"'", at + 1);
    if (end == std::string_view::npos || xml[end] != ';') {
        refuse(at, "an \"&\" that begins no reference");
    }
    const std::string_view name = xml.substr(at + 1, end - at - 1);
    if (name.starts_with('#')) {
        checkCharacterReference(at, name.substr(1));
    } else if (std::find(kEntities.begin(), kEntities.end(), name) == kEntities.end()) {
        refuse(at, "an entity beyond the five of XML");
    }
    return end + 1;
}

/// The position after the first `terminator` from `at` on, or the end: the parser reports a missing
/// terminator.
std::size_t pastNext(std::string_view xml, std::size_t at, std::string_view terminator) {
    const std::size_t found = xml.find(terminator, at);
    return found == std::string_view::npos ? xml.size() : found + terminator.size();
}

bool equalIgnoringCase(std::string_view text, std::string_view upper) {
    return std::equal(text.begin(), text.end(), upper.begin(), upper.end(), [](char a, char b) {
        return (a >= 'a' && a <= 'z' ? static_cast<char>(a - 'a' + 'A') : a) == b;
    });
}

/// If a declaration (`<?xml … ?>`) names an encoding, it must be UTF-8 or a subset.
void checkDeclaration(std::size_t offset, std::string_view declaration) {
    constexpr std::string_view kEncoding = "encoding";
    const std::size_t found = declaration.find(kEncoding);
    if (found == std::string_view::npos) {
        return;
    }
    const std::size_t open = declaration.find_first_of("\"'", found);
    if (open == std::string_view::npos) {
        return;
    }
    const std::size_t close = declaration.find(declaration[open], open + 1);
    const std::string_view name = declaration.substr(open + 1, close - open - 1);
    if (!equalIgnoringCase(name, "UTF-8") && !equalIgnoringCase(name, "US-ASCII")) {
        refuse(offset + open + 1, "an encoding other than UTF-8");
    }
}

/// Skips a document type, which is never fetched; refuses one with declarations.
std::size_t skipDocumentType(std::string_view xml, std::size_t at) {
    for (++at; at < xml.size() && xml[at] != '>'; ++at) {
        if (xml[at] == '[' || xml[at] == '<') {
            refuse(at, "a document type with declarations of its own");
        }
        if (xml[at] == '"' || xml[at] == '\'') {
            at = pastNext(xml, at + 1, xml.substr(at, 1)) - 1;
        }
    }
    return std::min(at + 1, xml.size());
}

/// The start of the next tag or reference from `at` on, or the end. (The library's search for one
/// of two letters calls a function for each letter.)
std::size_t nextMarkup(std::string_view xml, std::size_t at) {
    while (at < xml.size() && xml[at] != '<' && xml[at] != '&') {
        ++at;
    }
    return at;
}

/// Checks the attribute values of a tag.
std::size_t checkTag(std::string_view xml, std::size_t at) {
    char quote = 0;
    while (at < xml.size() && (quote != 0 || xml[at] != '>')) {
        const char letter = xml[at];
        if (letter == '&') {
            at = checkReference(xml, at);
            continue;
        }
        if (quote == 0 && (letter == '"' || letter == '\'')) {
            quote = letter;
        } else if (letter == quote) {
            quote = 0;
        }
        ++at;
    }
    return std::min(at + 1, xml.size());
}

std::size_t checkMarkup(std::string_view xml, std::size_t at) {
    const std::string_view rest = xml.substr(at);
    if (rest.starts_with("<!--")) {
        return pastNext(xml, at + 4, "-->");
    }
    if (rest.starts_with("<![CDATA[")) {
        return pastNext(xml, at + 9, "]]>");
    }
    if (rest.starts_with("<?")) {
        const std::size_t end = pastNext(xml, at + 2, "?>");
        if (rest.starts_with("<?xml")) {
            checkDeclaration(at, xml.substr(at, end - at));
        }
        return end;
    }
    return rest.starts_with("<!DOCTYPE") ? skipDocumentType(xml, at) : checkTag(xml, at);
}

} // namespace

void checkXmlMarkup(std::string_view xml) {
    checkCharacters(xml);
    for (std::size_t at = nextMarkup(xml, 0); at < xml.size(); at = nextMarkup(xml, at)) {
        at = xml[at] == '&' ? checkReference(xml, at) : checkMarkup(xml, at);
    }
}

} // namespace pallax
