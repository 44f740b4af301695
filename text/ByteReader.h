#pragma once

#include "text/Bytes.h"

#include <cstddef>
#include <cstdint>
#include <optional>

namespace pallax {

/// Reads at offsets of bytes that it does not own. A read that is not entirely inside them returns
/// nothing.
class ByteReader {
public:
    explicit ByteReader(Bytes bytes) : _bytes(bytes) {}

    std::size_t size() const { return _bytes.size(); }

    std::optional<Bytes> bytes(std::uint64_t offset, std::uint64_t length) const {
        if (offset > _bytes.size() || length > _bytes.size() - offset) {
            return std::nullopt;
        }
        return _bytes.subspan(static_cast<std::size_t>(offset), static_cast<std::size_t>(length));
    }

    /// An unsigned big-endian number of `width` bytes, 1 to 8.
    std::optional<std::uint64_t> number(std::uint64_t offset, std::size_t width) const {
        const auto digits = bytes(offset, width);
        if (!digits) {
            return std::nullopt;
        }
        std::uint64_t value = 0;
        for (const std::uint8_t digit : *digits) {
            value = (value << 8U) | digit;
        }
        return value;
    }

private:
    Bytes _bytes;
};

} // namespace pallax
