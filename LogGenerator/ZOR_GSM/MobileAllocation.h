#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The hopping sequence of the serving cell, section "Mobile Allocation".
///
///   0x51F8, at least 15 bytes
///   byte     width  key       shown as
///   13       8      HSN       number
///   14       8                number of channels
///   15 + 2i  16     ARFCNs    array of numbers, one for each channel
///
/// Each record replaces the array with a new one.
class MobileAllocation final : public LayoutRecord {
public:
    MobileAllocation();
};

} // namespace pallax
