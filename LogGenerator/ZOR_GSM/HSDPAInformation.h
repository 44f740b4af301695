#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The HARQ statistics of the high-speed downlink, section "HSDPA Info". A packet without
/// processes of a kind does not change the list of that kind.
///
///   0x4221, at least 18 bytes, little-endian
///   byte             bit  width   key                     shown as
///   13               0    8       Version                 number
///   14               0    10      Sub Frames              number
///   15               2    2       Carrier Info            label (kCarriers), "Unknown" beyond
///   16               0    8                               primary process count p
///   17               0    8                               secondary process count s
///   18 + 9i               9 byte  Primary HARQ Process    process i
///   18 + 162p + 9i        9 byte  Secondary HARQ Process  process i: 162 bytes behind 18 for each
///                                                         primary process, not 9
///
///   process
///   byte  width  key           shown as
///   0     8      Process ID    number
///   1     32     No Rx Bits    number
///   5     16     New Tx        number
///   7     16     Block Errors  number
class HSDPAInformation final : public LayoutRecord {
public:
    HSDPAInformation();
};

} // namespace pallax
