#include "simulator/RecordWriter.h"
#include "simulator/gsm/GsmRecords.h"

namespace pallax::gsm {

//   byte  width  0x51FD, 35 bytes
//   13    8      status of the packet system information messages
//   14    8      count LR
//   15    8      count HR
//   16    8      extended measurement order
//   33    8      packet system information status
void encode(const ExtendedMeasurement& measurement, ByteBuffer& out) {
    constexpr std::size_t kStatusOffset = 33;
    constexpr std::size_t kLength = 35;
    RecordWriter(out, 0x51FD)
        .u8(measurement.psiStatus)
        .u8(measurement.countLr)
        .u8(measurement.countHr)
        .u8(measurement.order)
        .padTo(kStatusOffset)
        .u8(measurement.siStatus ? 1 : 0)
        .padTo(kLength);
}

} // namespace pallax::gsm
