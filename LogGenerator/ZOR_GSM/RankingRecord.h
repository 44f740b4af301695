#pragma once

#include "LogGenerator/Records/LogCode.h"

#include <cstddef>

/// Shared by the two sets of the ranking record. Each set has its own count and stride, but both
/// lists begin at the same offset: they overlap, on purpose.
///
///   0x4005, at least 15 bytes
///   byte      width    field
///   13        8        UMTS entry count
///   14        8        GSM entry count
///   15 + 10i  10 byte  UMTS entry i
///   15 + 7i   7 byte   GSM entry i
namespace pallax {

inline constexpr LogCode kRankingLogCode = 0x4005;
inline constexpr std::size_t kRankingRecordLength = 15;
inline constexpr std::size_t kRankingEntriesStart = 15;

} // namespace pallax
