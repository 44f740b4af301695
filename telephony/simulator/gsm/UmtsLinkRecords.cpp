#include "telephony/simulator/RecordWriter.h"
#include "telephony/simulator/gsm/UmtsRecords.h"

namespace pallax::gsm {

//   byte  width  0x4125, 14 bytes
//   13    8      state
void encode(RrcState state, ByteBuffer& out) {
    RecordWriter(out, 0x4125).u8(static_cast<unsigned>(state));
}

//   byte  width  0x4157, 19 bytes
//   13    8      ciphering enabled
void encode(const Ciphering& ciphering, ByteBuffer& out) {
    constexpr std::size_t kLength = 19;
    RecordWriter(out, 0x4157).u8(ciphering.enabled ? 1 : 0).padTo(kLength);
}

//   byte  width  0x4031
//   14    8      number of slots
//   16    112    each slot: byte 4 the power, tenths of a dB above -70 dBm, less 512 (16)
void encode(const TransmitPower& power, ByteBuffer& out) {
    constexpr int kLeastDbm = -70;
    constexpr int kTenths = 10;
    constexpr int kOffset = 512;
    constexpr std::size_t kBefore = 4;
    constexpr std::size_t kAfter = 8;
    RecordWriter record(out, 0x4031);
    record.u8(0).u8(static_cast<unsigned>(power.slots_dbm.size())).u8(0);
    for (const int slot_dbm : power.slots_dbm) {
        record.skip(kBefore).s16((slot_dbm - kLeastDbm) * kTenths - kOffset).skip(kAfter);
    }
}

//   byte  width  0x4116
//   13    8      number of channels
//   14    16     window, blocks
//   16    72     each channel: identity (8), blocks received (32), in error (32)
void encode(const BlockErrors& errors, ByteBuffer& out) {
    RecordWriter record(out, 0x4116);
    record.u8(static_cast<unsigned>(errors.channels.size())).u16(errors.window);
    for (const ChannelBlocks& channel : errors.channels) {
        record.u8(channel.channel).u32(channel.received).u32(channel.inError);
    }
}

namespace {

void putProcesses(RecordWriter& record, std::span<const HarqProcess> processes) {
    for (const HarqProcess& process : processes) {
        record.u8(process.id).u32(process.receivedBits);
        record.u16(process.newTransmissions).u16(process.blockErrors);
    }
}

} // namespace

//   byte        bit  width  0x4221
//   13          0    8      version
//   14          0    10     sub-frames
//   15          2    2      carriers
//   16          0    8      number P of primary processes
//   17          0    8      number of secondary processes
//   18          0    72     each primary process: identity (8), bits received (32), new
//                           transmissions (16), block errors (16)
//   18 + 162P   0    72     each secondary process, the same
void encode(const Hsdpa& hsdpa, ByteBuffer& out) {
    constexpr unsigned kCarriersShift = 10;
    constexpr std::size_t kProcessesStart = 18;
    constexpr std::size_t kStride = 162;
    RecordWriter record(out, 0x4221);
    record.u8(1).u16(hsdpa.subFrames | static_cast<unsigned>(hsdpa.carriers) << kCarriersShift);
    record.u8(static_cast<unsigned>(hsdpa.primary.size()));
    record.u8(static_cast<unsigned>(hsdpa.secondary.size()));
    putProcesses(record, hsdpa.primary);
    if (!hsdpa.secondary.empty()) {
        record.padTo(kProcessesStart + kStride * hsdpa.primary.size());
        putProcesses(record, hsdpa.secondary);
    }
}

} // namespace pallax::gsm
