#pragma once

#include "LogGenerator/Records/Layout.h"

/// The log record that carries both the block errors and the signal-to-interference ratios.
///
///   0xD00C, at least 17 bytes
///   byte           bit  width   field
///   14             6    6       number of transport channels, T (the low bits in byte 14)
///   15             4    4       number of coded composite transport channels, S
///   17 + 2i             2 byte  transport channel i
///   289 + 34T + 8i      8 byte  composite channel i
///
/// The composite channels begin at this place even if the transport channels before them take
/// fewer bytes.
namespace pallax {

inline constexpr LogCode kChannelQualityLogCode = 0xD00C;
inline constexpr std::size_t kChannelQualityMinimumLength = 17;

inline constexpr Position kTransportChannelCount = bitsAt(14, 6, 6);
inline constexpr EntryRun kTransportChannels{{.start = 17, .stride = 2, .bytesRead = 2}};

inline constexpr Position kCompositeChannelCount = bitsAt(15, 4, 4);
inline constexpr EntryRun kCompositeChannels{{.start = 289, .stride = 8, .bytesRead = 8},
                                             EntryRun::Move{34, kTransportChannelCount}};

} // namespace pallax
