#include "telephony/simulator/RecordWriter.h"
#include "telephony/simulator/gsm/GsmRecords.h"

namespace pallax::gsm {

//   byte  width  0x51F4, 15 bytes
//   14    8      position: broadcast channel (0) or the extended one (1)
void encode(const Si13Position& position, ByteBuffer& out) {
    RecordWriter(out, 0x51F4).u8(0).u8(position.extended ? 1 : 0);
}

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

//   byte  width  0x51FB, 34 bytes
//   13    8      packet broadcast channel present
void encode(const PacketBroadcast& broadcast, ByteBuffer& out) {
    constexpr std::size_t kLength = 34;
    RecordWriter(out, 0x51FB).u8(broadcast.present ? 1 : 0).padTo(kLength);
}

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
