#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The radio-resource state machine, receive level and quality, section "GSM RR Info".
///
///   0x512C, at least 17 bytes
///   byte  width  key                 shown as
///   13    8      RR State            label (kRRStates), "Unknown" beyond
///   14    8      RR Sub State        number
///   15    8      RR Status           number
///   16    8      RR Mode             "Data", "Voice" for 0
///
///   0x5137, at least 29 bytes
///   byte  width  key                 shown as
///   15    8      Serving Rx Level    number
///   16    32     Rx Quality Full     signed
///   20    32     Rx Quality Sub      signed
///
///   0x5072, at least 20 bytes
///   byte  width  key                 shown as
///   19    8      DTX Used            "ON", "OFF" for 0
///
///   0x51F6, at least 24 bytes
///   byte  width  key                 shown as
///   16    8      DRX Used            number, sec
///
/// GSMServingCell reads the low halves of the words at 16 and 20 of 0x5137, unsigned, and shows
/// them under other names.
class GSMRRInfo final : public LayoutRecord {
public:
    GSMRRInfo();
};

} // namespace pallax
