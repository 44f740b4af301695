#pragma once

#include <cstdint>
#include <memory>
#include <span>
#include <vector>

namespace pallax {

/// Bytes owned elsewhere. A null message is an empty span.
using Bytes = std::span<const std::uint8_t>;

/// Owned bytes.
using ByteBuffer = std::vector<std::uint8_t>;

/// Immutable bytes shared by several owners (a property list's data value).
using SharedBytes = std::shared_ptr<const ByteBuffer>;

constexpr unsigned kByteBits = 8;

} // namespace pallax
