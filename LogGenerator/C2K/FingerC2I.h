#pragma once

#include "LogGenerator/Records/LogCode.h"
#include "LogGenerator/Records/LogRecord.h"
#include "plist/PropertyList.h"

namespace pallax {

struct CodeDescription;

/// What the fingers of the EV-DO receiver are locked to, and how well.
///
///   0x108A, exactly 23 bytes and 14 for each finger, little-endian
///   byte  width  lookup name   shown as
///   22    8                    number of fingers
///   23           kFingerC2I    list by pilot, or "(none)"
///
///   a finger, 14 bytes
///   0     16     PN offset; 0xFFFF: locked to nothing, not shown
///   6     16     carrier to interference: 10 x log10(raw / 512), dB
void parseFingerC2I(const LogRecord& packet, Dictionary& state, const Dictionary& lookup);

/// Whether `parseFingerC2I` accepts the packet; it then sets every value that it ever sets, and
/// logs nothing.
bool isWholeFingerC2I(const LogRecord& packet);

/// What that reads and shows, under the log code `logCode`.
CodeDescription describeFingerC2I(LogCode logCode);

} // namespace pallax
