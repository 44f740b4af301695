#pragma once

#include "LogGenerator/Records/EntryList.h"
#include "LogGenerator/Records/LogCode.h"

#include <array>

/// The log record that carries both the block errors and the signal-to-interference ratios.
///
///   0xD00C, at least 17 bytes
///   byte           bit  width   field
///   14             6    6       number of transport channels, T (the low bits in byte 14)
///   15             4    4       number of coded composite transport channels, S
///   17 + 2i             2 byte  transport channel i
///   289 + 34T + 8j      8 byte  composite channel j
///
/// The composite channels begin at their fixed place, however few bytes the transport channels
/// take before it.
namespace pallax {

inline constexpr LogCode kChannelQualityLogCode = 0xD00C;
inline constexpr auto kChannelQualityLogCodes = std::to_array<LogCode>({kChannelQualityLogCode});
inline constexpr std::size_t kChannelQualityMinimumLength = 17;

inline constexpr Position kTransportChannelCount = bitsAt(14, 6, 6);
inline constexpr EntryList::Layout kTransportChannels{.start = 17, .stride = 2, .bytesRead = 2};

inline constexpr Position kCompositeChannelCount = bitsAt(15, 4, 4);
/// Where they begin when there is no transport channel.
inline constexpr EntryList::Layout kCompositeChannels{.start = 289, .stride = 8, .bytesRead = 8};
inline constexpr std::size_t kPerTransportChannel = 34;

inline std::size_t transportChannelCount(const LogRecord& record) {
    return static_cast<std::size_t>(record.read(kTransportChannelCount));
}

inline EntryList transportChannels(const LogRecord& record) {
    return {record, kTransportChannels, transportChannelCount(record)};
}

inline EntryList compositeChannels(const LogRecord& record) {
    EntryList::Layout layout = kCompositeChannels;
    layout.start += kPerTransportChannel * transportChannelCount(record);
    return {record, layout, static_cast<std::size_t>(record.read(kCompositeChannelCount))};
}

} // namespace pallax
