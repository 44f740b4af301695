#include "simulator/RecordWriter.h"
#include "simulator/gsm/GsmRecords.h"

namespace pallax::gsm {

//   byte  width  0x51F6, 24 bytes
//   15    8      T3192
//   16    8      DRX timer, seconds
//   17    8      access bursts of 11 bits (1) or of 8 (0)
void encode(const PacketTimers& timers, ByteBuffer& out) {
    constexpr std::size_t kLength = 24;
    RecordWriter(out, 0x51F6)
        .u16(0)
        .u8(timers.t3192)
        .u8(timers.drxTimer_s)
        .u8(timers.elevenBitBursts ? 1 : 0)
        .padTo(kLength);
}

} // namespace pallax::gsm
