#include "masking/Replacement.h"

#include "masking/BitField.h"

#include <algorithm>
#include <array>
#include <openssl/evp.h>
#include <openssl/hmac.h>
#include <stdexcept>

namespace pallax {

namespace {

constexpr unsigned kDigits = 10;      ///< values of a half that are decimal digits
constexpr unsigned kMarkedWidth = 24; ///< the narrowest number that is marked
constexpr std::uint64_t kMark = 0xFF;

} // namespace

/// So many bytes of HMACs over the value and a counter; zeros without a key.
ByteBuffer Replacement::stream(Bytes value, std::size_t length) const {
    ByteBuffer result;
    if (!_key) {
        result.resize(length, 0);
        return result;
    }
    ByteBuffer message(value.begin(), value.end());
    message.push_back(0);
    result.reserve(length + EVP_MAX_MD_SIZE);
    while (result.size() < length) {
        std::array<std::uint8_t, EVP_MAX_MD_SIZE> digest{};
        unsigned size = 0;
        if (HMAC(EVP_sha256(), _key->data(), static_cast<int>(_key->size()), message.data(),
                 message.size(), digest.data(), &size) == nullptr) {
            throw std::runtime_error("a pseudonym cannot be computed");
        }
        result.insert(result.end(), digest.begin(), digest.begin() + size);
        ++message.back(); // pseudonyms are shorter than 256 digests or repeat themselves
    }
    result.resize(length);
    return result;
}

ByteBuffer Replacement::bytes(Bytes value, std::size_t length) const {
    ByteBuffer result = stream(value, length);
    if (isKeyed()) {
        constexpr unsigned kOthers = 16 - kDigits;
        for (std::uint8_t& byte : result) {
            const unsigned high = kDigits + (byte >> kHalfBits) % kOthers;
            const unsigned low = kDigits + (byte & kHalf) % kOthers;
            byte = static_cast<std::uint8_t>(high << kHalfBits | low);
        }
    }
    return result;
}

std::string Replacement::letters(Bytes value, std::size_t length) const {
    std::string result;
    result.reserve(length);
    for (const std::uint8_t byte : stream(value, length)) {
        result += isKeyed() ? static_cast<char>('a' + (byte & kHalf)) : '0';
    }
    return result;
}

std::string Replacement::digits(Bytes value, std::size_t length) const {
    constexpr std::size_t kMostDigits = 18; // of any number of 63 bits
    constexpr std::size_t kNines = 3;
    constexpr unsigned kTen = 10;
    std::string result(length, '0');
    if (!isKeyed()) {
        return result;
    }
    const ByteBuffer drawn = stream(value, length);
    const std::size_t first = length - std::min(length, kMostDigits);
    for (std::size_t at = first; at < length; ++at) {
        result[at] = at < first + kNines ? '9' : static_cast<char>('0' + drawn[at] % kTen);
    }
    return result;
}

std::uint64_t Replacement::bits(Bytes value, unsigned width) const {
    constexpr unsigned kMost = 64;
    std::uint64_t number = 0;
    for (const std::uint8_t byte : stream(value, sizeof(number))) {
        number = number << kByteBits | byte;
    }
    return width == 0 ? 0 : number >> (kMost - std::min(width, kMost));
}

std::uint64_t Replacement::number(Bytes value, unsigned width) const {
    const std::uint64_t number = bits(value, width);
    return isKeyed() && width >= kMarkedWidth ? number | kMark << (width - kByteBits) : number;
}

bool Replacement::isOne(std::uint64_t number, unsigned width) {
    return number == 0 || (width >= kMarkedWidth && number >> (width - kByteBits) == kMark);
}

bool Replacement::isOne(const PropertyList& value) {
    if (const SharedBytes data = value.data()) {
        const auto isMarked = [](std::uint8_t byte) {
            return (byte >> kHalfBits) >= kDigits && (byte & kHalf) >= kDigits;
        };
        const auto isZero = [](std::uint8_t byte) { return byte == 0; };
        return std::all_of(data->begin(), data->end(), isZero) ||
               std::all_of(data->begin(), data->end(), isMarked);
    }
    if (const auto text = value.string()) {
        return text->find_first_not_of('0') == std::string::npos ||
               text->find_first_not_of("abcdefghijklmnop") == std::string::npos;
    }
    const auto number = value.integer();
    if (!number) {
        return true; // other types get zeros only, and tell nobody
    }
    constexpr std::int64_t kFewDigits = 999'999; // no identity
    constexpr unsigned kNarrow = 31;
    constexpr unsigned kWide = 63;
    return (*number >= 0 && *number <= kFewDigits) || std::to_string(*number).starts_with("999") ||
           isOne(static_cast<std::uint64_t>(*number), kNarrow) ||
           isOne(static_cast<std::uint64_t>(*number), kWide);
}

} // namespace pallax
