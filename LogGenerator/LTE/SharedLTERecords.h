#pragma once

#include "LogGenerator/Records/LogCode.h"
#include "text/NumberFormat.h"

#include <cstddef>

/// Shared by several records of this technology: log codes with their least length, counts, and
/// the formats of levels.
namespace pallax {

/// Connected-mode intra-frequency measurement:
///
///   byte     width  field
///   27       8      measured neighbour cells, N
///   28       8      detected cells, D
///   29       6 x N  measured neighbour entries
///   29 + 6N  2 x D  detected cell entries
inline constexpr LogCode kConnectedModeLogCode = 0xB179;
inline constexpr std::size_t kConnectedModeLength = 29;
inline constexpr std::size_t kMeasuredCountOffset = 27;
inline constexpr std::size_t kDetectedCountOffset = 28;
inline constexpr std::size_t kMeasuredEntryLength = 6;
inline constexpr std::size_t kDetectedEntryLength = 2;

/// Idle-mode neighbour measurement.
inline constexpr LogCode kNeighborMeasurementLogCode = 0xB180;
inline constexpr std::size_t kNeighborMeasurementLength = 21;

/// Candidates of the idle-mode reselection.
inline constexpr LogCode kReselectionLogCode = 0xB186;
inline constexpr std::size_t kReselectionLength = 21;

inline constexpr NumberFormat kLevelDbm{"%4.2f dBm"};
inline constexpr NumberFormat kLevelDb{"%4.2f dB"};

} // namespace pallax
