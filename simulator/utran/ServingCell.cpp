#include "simulator/RecordWriter.h"
#include "simulator/utran/UtranRecords.h"

namespace pallax::utran {

//   byte  width  0xD0E2
//   14    8      access restrictions
//   15    8      URA identity
//   17    16     uplink UARFCN
//   19    16     downlink UARFCN
//   21    32     cell identity
//   25    1      emergency calls only
void encode(const ServingCell& cell, ByteBuffer& out) {
    RecordWriter(out, 0xD0E2)
        .u8(1)
        .u8(cell.accessRestrictions)
        .u8(cell.ura)
        .u8(0)
        .u16(cell.uplinkUarfcn)
        .u16(cell.downlinkUarfcn)
        .u32(cell.cellId)
        .u8(cell.emergencyCallsOnly ? 1 : 0);
}

} // namespace pallax::utran
