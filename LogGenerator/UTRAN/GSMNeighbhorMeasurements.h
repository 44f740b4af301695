#pragma once

#include "LogGenerator/Records/LayoutRecord.h"

namespace pallax {

/// The GSM neighbour cells, section "GSM Neighbor Cell List". A record empties the section; its
/// cells are read but never shown.
///
///   0xD00E, at least 17 bytes, little-endian
///   byte     bit  width   field
///   16            8       number of cells
///   17 + 8i       8 byte  cell i
///
///   cell
///   byte  bit  width  key             shown as
///   0     0    14     Cell ID         number
///   1     6    1      Band Indicator  number
///   1     7    1      BSIC Valid      number
///   2          8      NCC             number
///   3          8      BCC             number
///   4          16     ARFCN           number
///   6          16     RSSI            signed
///
/// Short records and other codes are ignored silently.
class GSMNeighbhorMeasurements final : public LayoutRecord {
public:
    GSMNeighbhorMeasurements();

    /// The cells of a record of at least 17 bytes, up to the first that is not whole.
    static Array cellsOf(const LogRecord& record);
};

} // namespace pallax
