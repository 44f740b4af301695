#include "telephony/simulator/Measurement.h"
#include "telephony/simulator/RecordWriter.h"
#include "telephony/simulator/cdma/CdmaRecords.h"

#include <cmath>

namespace pallax::cdma {

namespace {

/// In 512ths.
unsigned rawPart(double part_db) {
    constexpr double kWhole = 512;
    return rawOf(kWhole * std::pow(10.0, part_db / 10), 0, 1, 16);
}

} // namespace

//   byte  bit  width  0x1183, 50 bytes
//   13    0    11     channel
//   14    3    5      band class
//   15    0    8      receive level of the first antenna, dBm
//   16    0    8      of the second one
//   17    0    8      transmit level, dBm
//   18    0    16     PN of the serving pilot
//   36    0    8      state
//   37    0    8      session
//   38    0    24     UATI
//   41    0    8      color code
void encode(const EvdoStatus& status, ByteBuffer& out) {
    constexpr std::size_t kStateOffset = 36;
    constexpr std::size_t kLength = 50;
    constexpr unsigned kBandShift = 11;
    RecordWriter(out, 0x1183)
        .u16(status.channel | status.bandClass << kBandShift)
        .s8(status.receive0_dbm)
        .s8(status.receive1_dbm)
        .s8(status.transmit_dbm)
        .u16(status.servingPn)
        .padTo(kStateOffset)
        .u8(static_cast<unsigned>(status.state))
        .u8(static_cast<unsigned>(status.session))
        .u24(status.uati24)
        .u8(status.colorCode)
        .padTo(kLength);
}

//   byte  width  0x12B6
//   15    8      number of pilots
//   25    96     each pilot: PN (16), part of the power in 512ths (16), 8 bytes more
void encode(const EvdoActiveSet& set, ByteBuffer& out) {
    constexpr std::size_t kCountOffset = 15;
    constexpr std::size_t kPilotsStart = 25;
    constexpr std::size_t kRestOfPilot = 8;
    RecordWriter record(out, 0x12B6);
    record.padTo(kCountOffset).u8(static_cast<unsigned>(set.pilots.size())).padTo(kPilotsStart);
    for (const Pilot& pilot : set.pilots) {
        record.u16(pilot.pn).u16(rawPart(pilot.part_db)).skip(kRestOfPilot);
    }
}

//   byte  width  0x108A
//   22    8      number of fingers
//   23    112    each finger: PN (16) or 0xFFFF, 4 bytes, part of the power in 512ths (16), 6
//                bytes more
void encode(const Fingers& fingers, ByteBuffer& out) {
    constexpr std::size_t kCountOffset = 22;
    constexpr std::size_t kBeforePart = 4;
    constexpr std::size_t kAfterPart = 6;
    constexpr unsigned kNotLocked = 0xFFFF;
    RecordWriter record(out, 0x108A);
    record.padTo(kCountOffset).u8(static_cast<unsigned>(fingers.locked.size()) + 1);
    for (const Pilot& finger : fingers.locked) {
        record.u16(finger.pn).skip(kBeforePart).u16(rawPart(finger.part_db)).skip(kAfterPart);
    }
    record.u16(kNotLocked).skip(kBeforePart + 2 + kAfterPart);
}

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

//   byte  width  0x127E, 1750 bytes
//   14    32     sequence number
//   114   32     packets of 1024 bits, one of several such counters
//   210   32     of 4096 bits
void encode(const ReversePackets& packets, ByteBuffer& out) {
    constexpr std::size_t kSmallOffset = 114;
    constexpr std::size_t kLargeOffset = 210;
    constexpr std::size_t kLength = 1750;
    RecordWriter record(out, 0x127E);
    record.u8(0).u32(packets.sequence);
    record.padTo(kSmallOffset).u32(packets.of1024);
    record.padTo(kLargeOffset).u32(packets.of4096).padTo(kLength);
}

} // namespace pallax::cdma
