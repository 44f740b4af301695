#pragma once

#include "LogGenerator/Records/LogCode.h"

#include <cstddef>

/// The log codes from which several records of this technology read their own fields, with the
/// least length that all of them require.
namespace pallax {

/// Serving and neighbour measurements.
inline constexpr LogCode kMeasurementLogCode = 0x5137;
inline constexpr std::size_t kMeasurementLength = 29;

/// Packet timers and DRX.
inline constexpr LogCode kPacketTimersLogCode = 0x51F6;
inline constexpr std::size_t kPacketTimersLength = 24;

/// Serving PLMN and network operating mode.
inline constexpr LogCode kServingPLMNLogCode = 0x7135;
inline constexpr std::size_t kServingPLMNLength = 32;

} // namespace pallax
