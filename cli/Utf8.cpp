#include "cli/Utf8.h"

#include <algorithm>

namespace pallax {

namespace {

constexpr unsigned char kFirstBeyondAscii = 0x80;

/// What the first byte of a UTF-8 sequence says of the rest: its length and the range of the
/// second byte, which excludes overlong forms, surrogates and what lies beyond U+10FFFF.
struct SequenceStart {
    std::size_t length = 0; // 0: no sequence starts so
    unsigned char lowest = 0x80;
    unsigned char highest = 0xBF;
};

SequenceStart sequenceStart(unsigned char first) {
    if (first >= 0xC2 && first <= 0xDF) {
        return {2};
    }
    if (first >= 0xE0 && first <= 0xEF) {
        return {3, static_cast<unsigned char>(first == 0xE0 ? 0xA0 : 0x80),
                static_cast<unsigned char>(first == 0xED ? 0x9F : 0xBF)};
    }
    if (first >= 0xF0 && first <= 0xF4) {
        return {4, static_cast<unsigned char>(first == 0xF0 ? 0x90 : 0x80),
                static_cast<unsigned char>(first == 0xF4 ? 0x8F : 0xBF)};
    }
    return {};
}

bool isControl(std::string_view character) {
    const auto first = static_cast<unsigned char>(character.front());
    if (first < kFirstBeyondAscii) {
        return first < 0x20 || first == 0x7F;
    }
    return first == 0xC2 && static_cast<unsigned char>(character[1]) < 0xA0; // U+0080 to U+009F
}

template <class Replaced>
void appendCharacters(std::string& out, std::string_view text, Replaced replaced) {
    while (!text.empty()) {
        const std::size_t length = utf8SequenceLength(text);
        const bool kept = length > 0 && !replaced(text.substr(0, length));
        out += kept ? text.substr(0, length) : kReplacementCharacter;
        text.remove_prefix(std::max<std::size_t>(length, 1));
    }
}

} // namespace

std::size_t utf8SequenceLength(std::string_view text) {
    if (static_cast<unsigned char>(text.front()) < kFirstBeyondAscii) {
        return 1;
    }
    const SequenceStart start = sequenceStart(static_cast<unsigned char>(text.front()));
    if (start.length == 0 || text.size() < start.length) {
        return 0;
    }
    const auto second = static_cast<unsigned char>(text[1]);
    if (second < start.lowest || second > start.highest) {
        return 0;
    }
    const auto continues = [](char byte) {
        return (static_cast<unsigned char>(byte) & 0xC0U) == 0x80U;
    };
    const std::string_view rest = text.substr(2, start.length - 2);
    return std::all_of(rest.begin(), rest.end(), continues) ? start.length : 0;
}

void appendValidUtf8(std::string& out, std::string_view text) {
    appendCharacters(out, text, [](std::string_view) { return false; });
}

void appendPrintable(std::string& out, std::string_view text) {
    appendCharacters(out, text, isControl);
}

} // namespace pallax
