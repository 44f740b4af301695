#pragma once

#include "LogGenerator/Records/LogCode.h"
#include "LogGenerator/Records/LogRecord.h"
#include "plist/PropertyList.h"

namespace pallax {

struct CodeDescription;

/// The pilots of the EV-DO active set and their energies.
///
///   0x12B6, at least 25 bytes and room for every pilot, little-endian
///   byte  width  lookup name        shown as
///   15    8                         number of pilots
///   25           kActiveSetPilots   list by pilot, or "(none)"
///
///   a pilot, 12 bytes
///   0     16     PN offset
///   2     16     energy: 10 x log10(raw / 512), dB
void parseEVDOActiveSet(const LogRecord& packet, Dictionary& state, const Dictionary& lookup);

/// Whether `parseEVDOActiveSet` accepts the packet; it then sets every value that it ever sets, and
/// logs nothing.
bool isWholeEVDOActiveSet(const LogRecord& packet);

/// What that reads and shows, under the log code `logCode`.
CodeDescription describeEVDOActiveSet(LogCode logCode);

} // namespace pallax
