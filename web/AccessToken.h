#pragma once

#include <string>
#include <string_view>

namespace pallax {

/// A secret that lets a client in: 128 random bits as 32 hexadecimal digits.
class AccessToken {
public:
    static constexpr std::size_t kDigits = 32;

    /// From the system's random source; throws std::system_error if that fails.
    static AccessToken random();
    explicit AccessToken(std::string text) : _text(std::move(text)) {}

    const std::string& text() const { return _text; }
    /// Takes the same time wherever the texts differ, so a token cannot be guessed digit by digit.
    bool is(std::string_view text) const;

private:
    std::string _text;
};

} // namespace pallax
