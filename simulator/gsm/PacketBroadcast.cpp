#include "simulator/RecordWriter.h"
#include "simulator/gsm/GsmRecords.h"

namespace pallax::gsm {

//   byte  width  0x51FB, 34 bytes
//   13    8      packet broadcast channel present
void encode(const PacketBroadcast& broadcast, ByteBuffer& out) {
    constexpr std::size_t kLength = 34;
    RecordWriter(out, 0x51FB).u8(broadcast.present ? 1 : 0).padTo(kLength);
}

} // namespace pallax::gsm
