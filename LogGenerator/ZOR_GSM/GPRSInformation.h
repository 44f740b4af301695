#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The packet-data parameters that the serving cell broadcasts, section "GPRS Information".
///
///   byte  width  key                        shown as
///   0x51F4, at least 15 bytes
///   14    8      SI13 Position              label by raw + 1 (kSI13Positions), "Unknown" beyond
///
///   0x51F5, at least 18 bytes; keys in this order
///   15    8      Network Control Order      label by raw + 1 (kControlOrders), "Unknown" beyond
///   13    8      PFC Supported              label by raw + 1 (kPFCSupports), "Unknown" beyond
///   14    8      Priority Access Threshold  label by raw + 1 (kAccessThresholds), "Unknown" beyond
///
///   0x51F6, at least 24 bytes; keys in this order
///   15    8      T3192                      label (kT3192), "?? ms" beyond
///   17    8      Access Burst Type          "11-bit format", "8-bit format" for 0
///   16    8      DRX Timer Max              number
///
///   0x51FB, at least 34 bytes
///   13    8      PBCCH Present              number
///
///   0x51FD, at least 35 bytes; keys in this order
///   16    8      Ext Measurement Order      number
///   13    8      Packet PSI Status          number
///   33    8      Packet SI Status           "Supported", "Not Supported" for 0
///   14    8      Count LR                   number
///   15    8      Count HR                   number
///
///   0x5137, at least 29 bytes
///   26    8      Cell Reselect Hysteresis   "Applied", "Not Applied" for 0
///
///   0x7135, at least 32 bytes
///   13    8      Network Operating Mode     label (kOperatingModes), "Unknown" beyond
///
/// Tables by raw + 1 start with the label for 255, the modem's value for a parameter that is not
/// present.
class GPRSInformation final : public LayoutRecord {
public:
    GPRSInformation();
};

} // namespace pallax
