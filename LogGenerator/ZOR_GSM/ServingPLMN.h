#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The network that the phone is on, section "Serving PLMN".
///
///   0x7132, at least 16 bytes
///   byte  width  key                   shown as
///   14    8      PLMN Sel Mod          label (kSelectionModes), "Unknown" beyond
///
///   0x7135, at least 32 bytes; keys in this order
///   byte  bit  width  key                    shown as
///   15    0    4      Mobile Country Code    digit 1
///   15    4    4                             digit 2
///   16    0    4                             digit 3
///   17    0    4      Mobile Network Code    digit 1
///   17    4    4                             digit 2
///   16    4    4                             digit 3
///   18    0    16     Location Area Code     number, big-endian
///   20    0    8      Routing Area Code      number
///   14    0    8      Service Type           label (kServiceTypes), "Unknown" beyond
///
///   0xFF0001, the cell-monitor array: the first serving cell of GSM or UMTS
///   constant             key                    shown as
///   kHXCellMonitorMCC    Mobile Country Code    number
///   kHXCellMonitorMNC    Mobile Network Code    number
///   kHXCellMonitorLAC    Location Area Code     number
///
/// Digits above 9 are shown as a blank. A two-digit network code from 0x7135 therefore ends in a
/// blank; one from the cell monitor does not.
class ServingPLMN final : public LayoutRecord {
public:
    ServingPLMN();
};

} // namespace pallax
