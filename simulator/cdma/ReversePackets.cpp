#include "simulator/RecordWriter.h"
#include "simulator/cdma/CdmaRecords.h"

namespace pallax::cdma {

//   byte  width  0x127E, 1750 bytes
//   14    32     sequence number
//   114   32     packets of 1024 bits, one of several such counters
//   210   32     of 4096 bits
void encode(const ReversePackets& packets, ByteBuffer& out) {
    constexpr std::size_t kSmallOffset = 114;
    constexpr std::size_t kLargeOffset = 210;
    constexpr std::size_t kWholeLength = 1750;
    RecordWriter record(out, 0x127E);
    record.u8(0).u32(packets.sequence);
    record.padTo(kSmallOffset).u32(packets.of1024);
    record.padTo(kLargeOffset).u32(packets.of4096).padTo(kWholeLength);
}

} // namespace pallax::cdma
