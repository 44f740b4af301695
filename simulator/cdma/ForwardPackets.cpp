#include "simulator/RecordWriter.h"
#include "simulator/cdma/CdmaRecords.h"

namespace pallax::cdma {

//   byte  width  0x1192, 241 bytes
//   13    32     sequence number
//   29    32     packets of 1024 bits, one of several such counters
//   125   32     of 2048 bits
//   197   32     of 4096 bits
void encode(const ForwardPackets& packets, ByteBuffer& out) {
    constexpr std::size_t kSmallOffset = 29;
    constexpr std::size_t kMiddleOffset = 125;
    constexpr std::size_t kLargeOffset = 197;
    constexpr std::size_t kLength = 241;
    RecordWriter record(out, 0x1192);
    record.u32(packets.sequence);
    record.padTo(kSmallOffset).u32(packets.of1024);
    record.padTo(kMiddleOffset).u32(packets.of2048);
    record.padTo(kLargeOffset).u32(packets.of4096).padTo(kLength);
}

} // namespace pallax::cdma
