#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The active set on a frequency that the phone is not on, section "Virtual Active Set". The
/// searcher's cell list empties it; cells of all set types are ignored.
///
///   0x417A, at least 16 bytes
///   byte  width  field
///   15    8      cell count; no cell is shown
class VirtualActiveSet final : public LayoutRecord {
public:
    VirtualActiveSet();
};

} // namespace pallax
