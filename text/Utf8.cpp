#include "text/Utf8.h"

#include <cstdint>

namespace pallax {

namespace {

constexpr char32_t kFirstOfTwo = 0x80;
constexpr char32_t kFirstOfThree = 0x800;
constexpr char32_t kFirstOfFour = 0x10000;

char32_t byteAt(std::string_view text, std::size_t at) {
    return static_cast<std::uint8_t>(text[at]);
}

char continuation(char32_t codePoint, unsigned shift) {
    return static_cast<char>(0x80U | ((codePoint >> shift) & 0x3FU));
}

} // namespace

Utf8CodePoint utf8At(std::string_view text, std::size_t at) {
    const char32_t lead = byteAt(text, at);
    if (lead < kFirstOfTwo) {
        return {lead, 1};
    }
    std::size_t size = 0;
    char32_t value = 0;
    char32_t least = 0;
    if ((lead & 0xE0U) == 0xC0U) {
        size = 2, value = lead & 0x1FU, least = kFirstOfTwo;
    } else if ((lead & 0xF0U) == 0xE0U) {
        size = 3, value = lead & 0x0FU, least = kFirstOfThree;
    } else if ((lead & 0xF8U) == 0xF0U) {
        size = 4, value = lead & 0x07U, least = kFirstOfFour;
    }
    if (size == 0 || size > text.size() - at) {
        return {};
    }
    for (std::size_t next = 1; next < size; ++next) {
        const char32_t byte = byteAt(text, at + next);
        if ((byte & 0xC0U) != 0x80U) {
            return {};
        }
        value = (value << 6U) | (byte & 0x3FU);
    }
    if (value < least || value > kLastCodePoint || isSurrogate(value)) {
        return {};
    }
    return {value, size};
}

std::optional<std::size_t> invalidUtf8At(std::string_view text) {
    for (std::size_t at = 0; at < text.size();) {
        const std::size_t size = utf8At(text, at).size;
        if (size == 0) {
            return at;
        }
        at += size;
    }
    return std::nullopt;
}

void appendUtf8(std::string& out, char32_t codePoint) {
    if (codePoint < kFirstOfTwo) {
        out += static_cast<char>(codePoint);
    } else if (codePoint < kFirstOfThree) {
        out += static_cast<char>(0xC0U | (codePoint >> 6U));
        out += continuation(codePoint, 0);
    } else if (codePoint < kFirstOfFour) {
        out += static_cast<char>(0xE0U | (codePoint >> 12U));
        out += continuation(codePoint, 6);
        out += continuation(codePoint, 0);
    } else {
        out += static_cast<char>(0xF0U | (codePoint >> 18U));
        out += continuation(codePoint, 12);
        out += continuation(codePoint, 6);
        out += continuation(codePoint, 0);
    }
}

} // namespace pallax
