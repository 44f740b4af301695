#pragma once

#include "LogGenerator/Records/LogCode.h"
#include "LogGenerator/Records/LogRecord.h"
#include "text/Bytes.h"

namespace pallax {

/// The first byte of a message that begins with the 2-byte transport prefix.
inline constexpr std::uint8_t kTransportPrefix = 0x81;
inline constexpr std::size_t kTransportPrefixLength = 2;

/// The log record of a message: the message without its transport prefix, if it has one. Null
/// (empty) for a null message and for one that contains only the prefix. A view into `data`.
///
///   byte  width  field
///   0     8      0x81
///   1     8      not interpreted
///   2            the log record
Bytes LogPacketStripPrefix(Bytes data);

/// The same without log lines, for callers other than the generators.
Bytes LogPacketRecord(Bytes data);

/// The end of the log type and log code in a record.
inline constexpr std::size_t kLogCodeEnd = 5;

/// The effective log code of a record of at least `kLogCodeEnd` bytes; checks neither length nor
/// log type.
LogCode LogPacketGetLogCode(const LogRecord& record);

} // namespace pallax
