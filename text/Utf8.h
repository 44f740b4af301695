#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

namespace pallax {

/// What a text file may begin with to say that it is UTF-8.
constexpr std::string_view kUtf8Mark = "\xEF\xBB\xBF";

/// One code point of a UTF-8 text and the bytes that it takes; 0 bytes where the text is no UTF-8.
struct Utf8CodePoint {
    char32_t value = 0;
    std::size_t size = 0;
};

/// The code point that starts at `at`, which must lie inside `text`. Overlong forms, surrogates
/// and numbers beyond U+10FFFF are no UTF-8.
Utf8CodePoint utf8At(std::string_view text, std::size_t at);

/// Where `text` ceases to be UTF-8, or nothing.
std::optional<std::size_t> invalidUtf8At(std::string_view text);

/// `codePoint` must be one: at most U+10FFFF and no surrogate.
void appendUtf8(std::string& out, char32_t codePoint);

constexpr bool isHighSurrogate(char32_t unit) {
    return unit >= 0xD800 && unit <= 0xDBFF;
}
constexpr bool isLowSurrogate(char32_t unit) {
    return unit >= 0xDC00 && unit <= 0xDFFF;
}
constexpr bool isSurrogate(char32_t unit) {
    return unit >= 0xD800 && unit <= 0xDFFF;
}
/// The code point of a pair of UTF-16 units.
constexpr char32_t joinSurrogates(char32_t high, char32_t low) {
    return 0x10000 + ((high - 0xD800) << 10U) + (low - 0xDC00);
}

inline constexpr char32_t kLastCodePoint = 0x10FFFF;

} // namespace pallax
