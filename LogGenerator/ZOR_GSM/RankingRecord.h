#pragma once

#include "LogGenerator/Records/LogCode.h"

#include <cstddef>

/// What the two sets of the ranking record share. Each has a count of its own, and both lists are
/// read from the same offset with strides of their own: the two readings overlap, on purpose.
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
