#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

namespace pallax {

/// The byte order mark with which a UTF-8 file may start.
constexpr std::string_view kUtf8Mark = "\xEF\xBB\xBF";

/// One code point of a UTF-8 text and its length in bytes; 0 bytes if the text is not UTF-8.
struct Utf8CodePoint {
    char32_t value = 0;
    std::size_t size = 0;
};

/// The code point that starts at `at`, which must be inside `text`. Overlong forms, surrogates and
/// numbers beyond U+10FFFF are invalid.
Utf8CodePoint utf8At(std::string_view text, std::size_t at);

/// The first position at which `text` is not UTF-8, if any.
std::optional<std::size_t> invalidUtf8At(std::string_view text);

/// `codePoint` must be valid: at most U+10FFFF and not a surrogate.
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
