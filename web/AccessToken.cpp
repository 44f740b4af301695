#include "web/AccessToken.h"

#include <array>
#include <cerrno>
#include <cstdint>
#include <sys/random.h>
#include <system_error>

namespace pallax {

AccessToken AccessToken::random() {
    std::array<std::uint8_t, kDigits / 2> bytes{};
    if (::getrandom(bytes.data(), bytes.size(), 0) != static_cast<ssize_t>(bytes.size())) {
        throw std::system_error(errno, std::generic_category(), "No random numbers");
    }
    constexpr std::string_view kHexadecimal = "0123456789abcdef";
    constexpr unsigned kHalf = 4;
    std::string text;
    for (const unsigned byte : bytes) {
        text += kHexadecimal[byte >> kHalf];
        text += kHexadecimal[byte & ((1U << kHalf) - 1)];
    }
    return AccessToken(text);
}

bool AccessToken::is(std::string_view text) const {
    if (text.size() != _text.size()) {
        return false;
    }
    volatile unsigned difference = 0; // so that the loop is not left early
    for (std::size_t index = 0; index < _text.size(); ++index) {
        const auto a = static_cast<unsigned char>(_text[index]);
        const auto b = static_cast<unsigned char>(text[index]);
        difference = difference | static_cast<unsigned>(a ^ b);
    }
    return difference == 0;
}

} // namespace pallax
