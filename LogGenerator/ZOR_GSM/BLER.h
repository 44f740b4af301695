#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The block errors of the transport channels, section "BLER".
///
///   0x4116, at least 16 bytes, little-endian
///   byte     width   key                    shown as
///   13       8                              channel count
///   14       16      Window Size            number
///   16 + 9i  9 byte  Transport Channels     channel i
///
///   channel
///   byte  width  key                    shown as
///   0     8      Transport Channel ID   number
///   1     32     CRC Received           signed
///   5     32     CRC Received in Error  signed
class BLER final : public LayoutRecord {
public:
    BLER();
};

} // namespace pallax
