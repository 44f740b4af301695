#pragma once

#include "LogGenerator/Records/Layout.h"

namespace pallax {

/// The 1x system that serves the phone.
///
///   0x134F, at least 171 bytes, version 2 or higher, little-endian
///   byte  width  lookup name         shown as
///   13    8                          version
///   42    32     k1xRoamingHome      label of the roaming indicator
///   46    32                         system type
///   50    16     kSystemId           number; of a system type other than 2 the type
///   52    16     kNetworkId          number; of a system type other than 2 the type
///   131   8      kPacketZoneId       number
///   133   8      kProtocolRevision   number
///   184   16     kBaseId             number; past the end of a shorter packet, so 0
extern const CodeLayout kOneXSystemIdentity;

} // namespace pallax
