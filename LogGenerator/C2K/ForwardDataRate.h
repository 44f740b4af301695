#pragma once

#include "LogGenerator/Records/LogCode.h"
#include "LogGenerator/Records/LogRecord.h"
#include "plist/PropertyList.h"

namespace pallax {

struct CodeDescription;

/// How much the EV-DO forward link has carried: counters, each with a weight of its own. Shown as a
/// rate; see DataRate.h.
///
///   0x1192, at least 241 bytes, little-endian
///   byte      width    lookup name   shown as
///   13        32                     sequence number
///   17        56 x 32  kFLDataRate   the counters: their weighted sum since the last packet
void parseForwardDataRate(const LogRecord& packet, Dictionary& state, const Dictionary& lookup);

/// What that reads and shows, under the log code `logCode`.
CodeDescription describeForwardDataRate(LogCode logCode);

} // namespace pallax
