#include "text/Base64.h"

#include "text/Bytes.h"

#include <array>
#include <cstdint>

namespace pallax {

namespace {

constexpr std::string_view kAlphabet =
    "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/";
constexpr std::uint8_t kNoDigit = 0xFF;
constexpr unsigned kDigitBits = 6;

constexpr std::array<std::uint8_t, 256> kDigits = [] {
    std::array<std::uint8_t, 256> digits{};
    digits.fill(kNoDigit);
    for (std::size_t digit = 0; digit < kAlphabet.size(); ++digit) {
        digits.at(static_cast<std::uint8_t>(kAlphabet[digit])) = static_cast<std::uint8_t>(digit);
    }
    return digits;
}();

bool isBlank(char letter) {
    return letter == ' ' || letter == '\t' || letter == '\n' || letter == '\r';
}

} // namespace

std::string base64Text(Bytes bytes) {
    std::string out;
    out.reserve((bytes.size() + 2) / 3 * 4);
    for (std::size_t at = 0; at < bytes.size(); at += 3) {
        const std::size_t count = bytes.size() - at < 3 ? bytes.size() - at : 3;
        std::uint32_t group = 0;
        for (std::size_t next = 0; next < 3; ++next) {
            group = (group << kByteBits) | (next < count ? bytes[at + next] : 0U);
        }
        for (unsigned digit = 0; digit < 4; ++digit) {
            const std::uint32_t value = (group >> (kDigitBits * (3 - digit))) & 0x3FU;
            out += digit <= count ? kAlphabet[value] : '=';
        }
    }
    return out;
}

std::optional<ByteBuffer> parseBase64(std::string_view text) {
    ByteBuffer out;
    out.reserve(text.size() / 4 * 3);
    std::uint32_t bits = 0;
    unsigned bitCount = 0;
    std::size_t digits = 0;
    std::size_t padding = 0;
    for (const char letter : text) {
        if (isBlank(letter)) {
            continue;
        }
        if (letter == '=') {
            ++padding;
            continue;
        }
        const std::uint8_t digit = kDigits.at(static_cast<std::uint8_t>(letter));
        if (digit == kNoDigit || padding > 0) {
            return std::nullopt;
        }
        ++digits;
        bits = (bits << kDigitBits) | digit;
        bitCount += kDigitBits;
        if (bitCount >= kByteBits) {
            bitCount -= kByteBits;
            out.push_back(static_cast<std::uint8_t>(bits >> bitCount));
            bits &= (1U << bitCount) - 1U;
        }
    }
    if (padding > 2 || (digits + padding) % 4 != 0 || bits != 0) {
        return std::nullopt;
    }
    return out;
}

} // namespace pallax
