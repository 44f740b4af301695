#include "simulator/RecordWriter.h"
#include "simulator/gsm/GsmRecords.h"

#include <algorithm>

namespace pallax::gsm {

namespace {

/// A level without its sign, as a byte.
unsigned unsignedLevel(int level_dbm) {
    return static_cast<unsigned>(std::clamp(-level_dbm, 0, 255));
}

} // namespace

//   byte  width  0x5137
//   15    8      level of the serving cell, without its sign
//   16    32     C1
//   20    32     C2
//   26    8      cell reselect hysteresis applied
//   28    8      number of neighbours
//   29    112    each neighbour: ARFCN (16), level (8), C1 (32), 7 bytes more
void encode(const CellMeasurement& measurement, ByteBuffer& out) {
    constexpr std::size_t kRestOfNeighbour = 7;
    RecordWriter record(out, 0x5137);
    record.u16(0).u8(unsignedLevel(measurement.level_dbm));
    record.s32(measurement.c1).s32(measurement.c2).u16(0);
    record.u8(measurement.hysteresisApplied ? 1 : 0).u8(0);
    record.u8(static_cast<unsigned>(measurement.neighbours.size()));
    for (const NeighbourLevel& cell : measurement.neighbours) {
        record.u16(cell.arfcn).u8(unsignedLevel(cell.level_dbm)).s32(cell.c1);
        record.skip(kRestOfNeighbour);
    }
}

} // namespace pallax::gsm
