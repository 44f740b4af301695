#pragma once

#include "telephony/simulator/ifx/MessageBuffer.h"

#include <array>
#include <charconv>
#include <cstddef>
#include <string_view>

namespace pallax::ifx {

/// "-85 dBm", "3,5": a text of two numbers at most and a few letters, put together in place.
class ShortText {
public:
    explicit ShortText(int number) { put(number); }
    explicit ShortText(unsigned number) { put(number); }

    ShortText& then(std::string_view letters) {
        for (const char letter : letters) {
            _letters.at(_size++) = letter;
        }
        return *this;
    }
    ShortText& then(unsigned number) {
        put(number);
        return *this;
    }
    std::string_view view() const { return {_letters.data(), _size}; }

private:
    template <class Number>
    void put(Number number) {
        const auto end =
            std::to_chars(_letters.data() + _size, _letters.data() + _letters.size(), number).ptr;
        _size = static_cast<std::size_t>(end - _letters.data());
    }

    // Two numbers of at most 11 letters, and what is between them.
    std::array<char, kShortPiece> _letters{};
    std::size_t _size = 0;
};

} // namespace pallax::ifx
