#include "text/Printable.h"

#include "text/Utf8.h"

#include <algorithm>
#include <array>
#include <cstdint>

namespace pallax {

namespace {

constexpr char32_t kDelete = 0x7F;
constexpr char32_t kFirstBeyondAscii = 0x80;

bool isControl(char32_t codePoint) {
    constexpr char32_t kFirstPrintable = 0x20;
    constexpr char32_t kFirstBehindC1 = 0xA0;
    return codePoint < kFirstPrintable || (codePoint >= kDelete && codePoint < kFirstBehindC1);
}

bool controlsDirection(char32_t codePoint) {
    constexpr char32_t kArabicLetterMark = 0x061C;
    struct Range {
        char32_t first;
        char32_t last;
    };
    constexpr auto kRanges = std::to_array<Range>({
        {kArabicLetterMark, kArabicLetterMark},
        {0x200E, 0x200F}, // marks
        {0x202A, 0x202E}, // embeddings and overrides
        {0x2066, 0x2069}, // isolates
    });
    return codePoint >= kArabicLetterMark &&
           std::any_of(kRanges.begin(), kRanges.end(), [codePoint](const Range& range) {
               return codePoint >= range.first && codePoint <= range.last;
           });
}

template <class Escaped>
void appendCharacters(std::string& out, std::string_view text, Escaped escaped) {
    for (std::size_t at = 0; at < text.size();) {
        const Utf8CodePoint character = utf8At(text, at);
        if (character.size == 0) {
            out += kReplacementCharacter;
        } else if (escaped(character.value)) {
            appendEscape(out, character.value);
        } else {
            out += text.substr(at, character.size);
        }
        at += std::max<std::size_t>(character.size, 1);
    }
}

/// The number of bytes at the end that begin a character, according to its leading byte.
std::size_t begunCharacter(std::string_view text) {
    constexpr std::size_t kMostBegun = 3;
    constexpr std::uint8_t kLastLead = 0xF4;
    constexpr auto kLeads = std::to_array<std::uint8_t>({0xC0, 0xE0, 0xF0}); // for 2, 3 and 4 bytes
    for (std::size_t size = 1; size <= std::min(kMostBegun, text.size()); ++size) {
        const auto byte = static_cast<std::uint8_t>(text[text.size() - size]);
        if (byte >= kLeads.front()) {
            return byte >= kLeads.at(size - 1) && byte <= kLastLead ? size : 0;
        }
        if (byte < kFirstBeyondAscii) {
            return 0;
        }
    }
    return 0;
}

} // namespace

bool commandsTerminal(char32_t codePoint) {
    return isControl(codePoint) || controlsDirection(codePoint);
}

void appendEscape(std::string& out, char32_t codePoint) {
    constexpr std::string_view kHexDigits = "0123456789ABCDEF";
    constexpr unsigned kBitsPerDigit = 4;
    const bool isAscii = codePoint < kFirstBeyondAscii;
    out += isAscii ? "\\x" : "\\u";
    for (unsigned digits = isAscii ? 2 : 4; digits > 0; --digits) {
        out += kHexDigits[(codePoint >> (kBitsPerDigit * (digits - 1))) & 0xFU];
    }
}

void appendValidUtf8(std::string& out, std::string_view text) {
    appendCharacters(out, text, [](char32_t /*codePoint*/) { return false; });
}

void appendPrintable(std::string& out, std::string_view text) {
    appendCharacters(out, text, commandsTerminal);
}

std::string printable(std::string_view text) {
    std::string out;
    appendPrintable(out, text);
    return out;
}

void appendPrintableLines(std::string& out, std::string_view text) {
    appendCharacters(out, text, [](char32_t codePoint) {
        return commandsTerminal(codePoint) && codePoint != '\n' && codePoint != '\t';
    });
}

void PrintablePieces::append(std::string& out, std::string_view piece) {
    _begun += piece;
    std::string text;
    text.swap(_begun);
    const std::size_t whole = text.size() - begunCharacter(text);
    _begun = text.substr(whole);
    appendPrintableLines(out, std::string_view(text).substr(0, whole));
}

} // namespace pallax
