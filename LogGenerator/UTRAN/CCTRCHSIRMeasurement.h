#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The signal-to-interference ratios of the coded composite transport channels, section
/// "CCTRCH SIR".
///
///   0xD00C, see ChannelQuality.h
///
///   composite channel
///   byte    width  key        shown as
///   0       8      CCTRCH ID  number
///   1       8      TSNUM      number
///   2 + 1i  8      SIR        list of six numbers
///
/// Short records and other codes are ignored silently.
class CCTRCHSIRMeasurement final : public LayoutRecord {
public:
    CCTRCHSIRMeasurement();
};

} // namespace pallax
