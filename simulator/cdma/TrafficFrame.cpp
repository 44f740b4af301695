#include "simulator/RecordWriter.h"
#include "simulator/cdma/CdmaRecords.h"
#include "simulator/cdma/Subpackets.h"

namespace pallax::cdma {

//   subpacket  byte  width  0x119D
//   11         24    8      the frame is in error
void encode(const TrafficFrame& frame, ByteBuffer& out) {
    constexpr unsigned kDemodulation = 11;
    constexpr std::size_t kSize = 28;
    constexpr std::size_t kBeforeError = 20;
    RecordWriter record(out, 0x119D);
    putHead(record, 1);
    subpacket(record, kDemodulation, kSize).skip(kBeforeError).u8(frame.inError ? 1 : 0).skip(3);
}

} // namespace pallax::cdma
