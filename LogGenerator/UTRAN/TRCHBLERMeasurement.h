#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The block error rates of the transport channels, section "TRCH BLER".
///
///   0xD00C, see ChannelQuality.h
///
///   transport channel
///   byte  width  key                    shown as
///   0     8      TRCH ID                number
///   1     8      TRCH BLER Measurement  number
///
/// Short records and other codes are ignored silently.
class TRCHBLERMeasurement final : public LayoutRecord {
public:
    TRCHBLERMeasurement();
};

} // namespace pallax
