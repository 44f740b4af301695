#pragma once

#include "simulator/ifx/MessageBuffer.h"

#include <algorithm>
#include <charconv>
#include <cstddef>
#include <cstdint>
#include <limits>
#include <string_view>

/// "-85 dBm", "3,5": texts of two numbers at most and a few letters, which are put together where
/// they are to stand. Put together elsewhere and copied, they cost a tenth of a message's time: the
/// copy waits until what it reads has left the processor.
namespace pallax::ifx {

/// Two numbers of 32 bits with their signs, and what is between or behind them.
inline constexpr std::size_t kMostLetters = 10;
inline constexpr std::size_t kLongestShortText = 11 + kMostLetters + 11;

inline std::uint8_t* putPart(std::uint8_t* place, std::string_view letters) {
    if (letters.size() > kMostLetters) {
        refuseMessage();
    }
    return std::copy(letters.begin(), letters.end(), place);
}

template <class Number>
std::uint8_t* putPart(std::uint8_t* place, Number number) {
    constexpr std::size_t kMostDigits = std::numeric_limits<Number>::digits10 + 2; // with a sign
    auto* letters = reinterpret_cast<char*>(place); // NOLINT: bytes are letters here
    return place + (std::to_chars(letters, letters + kMostDigits, number).ptr - letters);
}

/// Of at most two numbers and one piece of letters; what is longer throws std::length_error. How
/// many letters there are from `place` on, where there is room for kLongestShortText.
template <class... Parts>
std::size_t putShortText(std::uint8_t* place, const Parts&... parts) {
    std::uint8_t* end = place;
    ((end = putPart(end, parts)), ...);
    return static_cast<std::size_t>(end - place);
}

} // namespace pallax::ifx
