#include "simulator/RecordWriter.h"
#include "simulator/gsm/GsmRecords.h"

namespace pallax::gsm {

//   byte  width  0x51F5, 18 bytes
//   13    8      packet flow context supported
//   14    8      priority access threshold
//   15    8      network control order
void encode(const PacketControl& control, ByteBuffer& out) {
    constexpr std::size_t kLength = 18;
    RecordWriter(out, 0x51F5)
        .u8(control.pfcSupported)
        .u8(control.priorityThreshold)
        .u8(control.networkControlOrder)
        .padTo(kLength);
}

} // namespace pallax::gsm
