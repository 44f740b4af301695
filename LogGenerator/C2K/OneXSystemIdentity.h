#pragma once

#include "LogGenerator/Records/LogCode.h"
#include "LogGenerator/Records/LogRecord.h"
#include "plist/PropertyList.h"

namespace pallax {

struct CodeDescription;

/// Which 1x system serves the phone.
///
///   0x134F, at least 171 bytes, version 2 or higher, little-endian
///   byte  width  lookup name         shown as
///   13    8                          version
///   42    32     k1xRoamingHome      roaming indicator label
///   46    32                         system type
///   50    16     kSystemId           number; of a system type other than 2 the type
///   52    16     kNetworkId          number; of a system type other than 2 the type
///   131   8      kPacketZoneId       number
///   133   8      kProtocolRevision   number
///   184   16     kBaseId             number; past the end of a shorter packet, so 0
void parseOneXSystemIdentity(const LogRecord& packet, Dictionary& state, const Dictionary& lookup);

/// Whether `parseOneXSystemIdentity` accepts the packet; it then sets every value that it ever
/// sets, and logs nothing.
bool isWholeOneXSystemIdentity(const LogRecord& packet);

/// What that reads and shows, under the log code `logCode`.
CodeDescription describeOneXSystemIdentity(LogCode logCode);

} // namespace pallax
