#pragma once

#include "LogGenerator/Records/LogRecord.h"

#include <cstdint>
#include <span>

namespace pallax {

constexpr unsigned kHalfBits = 4; ///< of a byte that holds two digits
constexpr std::uint8_t kHalf = 0xF;

/// Writes the number at a position of a record, the inverse of LogRecord::read; bits past the end
/// are dropped.
void writeNumber(std::span<std::uint8_t> record, const Position& position, std::uint64_t number);

} // namespace pallax
