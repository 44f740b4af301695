#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The state of the radio resource control, section "RRC Info".
///
///   0xD0E0, at least 13 bytes
///   byte  width  key    shown as
///   13    8             record version
///   14    8      State  label (kModes), "Unknown RRC Mode" beyond
///
/// Only version 1 is understood; in other versions the mode counts as 255. A record shorter than
/// 15 bytes is reported, but still read. Other codes are ignored silently.
class RRC_State final : public LayoutRecord {
public:
    RRC_State();
};

} // namespace pallax
