#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The UMTS cells that the network has told the phone to watch, section "Monitored Set". The
/// searcher's cell list empties it; cells of all set types are ignored.
///
///   0x417A, at least 16 bytes
///   byte  width  field
///   15    8      cell count; no cell is shown
class MonitoredSet final : public LayoutRecord {
public:
    MonitoredSet();
};

} // namespace pallax
