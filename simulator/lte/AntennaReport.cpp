#include "simulator/RecordWriter.h"
#include "simulator/lte/LteRecords.h"

namespace pallax::lte {

//   byte  width  0xB0C1, 22 bytes
//   20    8      transmit antennas
void encode(const AntennaReport& report, ByteBuffer& out) {
    constexpr std::size_t kCountOffset = 20;
    constexpr std::size_t kLength = 22;
    RecordWriter(out, 0xB0C1).padTo(kCountOffset).u8(report.count).padTo(kLength);
}

} // namespace pallax::lte
