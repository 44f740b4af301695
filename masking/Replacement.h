#pragma once

#include "plist/PropertyList.h"
#include "text/Bytes.h"

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>

namespace pallax {

/// What stands in place of an identity: zeros or, with a key, a pseudonym that depends only on the
/// key and the identity (HMAC-SHA-256). The same value has the same pseudonym everywhere; without
/// the key, neither leads to the other. No pseudonym looks like an identity.
class Replacement {
public:
    /// Zeros.
    Replacement() = default;
    explicit Replacement(ByteBuffer key) : _key(std::move(key)) {}

    bool isKeyed() const { return _key.has_value(); }

    /// For data: zeros, or bytes without a decimal digit in either half.
    ByteBuffer bytes(Bytes value, std::size_t length) const;
    /// For a text: digits 0, or letters from "a" to "p".
    std::string letters(Bytes value, std::size_t length) const;
    /// For a decimal number: digits 0, or a number of that length that begins with 999 and fits 63
    /// bits.
    std::string digits(Bytes value, std::size_t length) const;
    /// For a binary number of at most 64 bits: zero, or a number whose upper 8 bits are set if it
    /// has 24 or more.
    std::uint64_t number(Bytes value, unsigned width) const;
    /// So many bits of the pseudonym.
    std::uint64_t bits(Bytes value, unsigned width) const;

    /// Whether `value` may be what this class puts in place of an identity, under any key: so it is
    /// no identity.
    static bool isOne(const PropertyList& value);
    static bool isOne(std::uint64_t number, unsigned width);

private:
    ByteBuffer stream(Bytes value, std::size_t length) const;

    std::optional<ByteBuffer> _key;
};

} // namespace pallax
