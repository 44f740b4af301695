#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The UMTS neighbour cells with the set that each belongs to, section "Neighbor Cell List".
///
///   0xD00A, at least 21 bytes
///   byte      bit  width    field
///   16        1    7        number of cells
///   168 + 16i      16 byte  cell i, of which the first four bytes are read
///
///   cell
///   byte  bit  width  key          shown as
///   0     0    14     UARFCN       number
///   1     6    7      Cell ID      number
///   2     5    8      Filter RSCP  raw x 0.00390625; six decimals
///   3     5    2      Status       label (kStatuses); no key for 3
///   3     7    1      inJDCS       "TRUE", "FALSE" for 0
///
/// Short records and other codes are ignored silently.
class UTRANNeighbhorMeasurements final : public LayoutRecord {
public:
    UTRANNeighbhorMeasurements();
};

} // namespace pallax
