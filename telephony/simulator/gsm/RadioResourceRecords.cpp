#include "telephony/simulator/RecordWriter.h"
#include "telephony/simulator/gsm/GsmRecords.h"

namespace pallax::gsm {

//   byte  width  0x5076, 17 bytes
//   13    16     ARFCN of the dedicated channel
void encode(const DedicatedChannel& channel, ByteBuffer& out) {
    constexpr std::size_t kLength = 17;
    RecordWriter(out, 0x5076).u16(channel.arfcn).padTo(kLength);
}

//   byte  width  0x512C, 17 bytes
//   13    8      state
//   14    8      sub-state
//   15    8      status
//   16    8      data (1) or voice (0)
void encode(const RrInfo& info, ByteBuffer& out) {
    RecordWriter(out, 0x512C)
        .u8(static_cast<unsigned>(info.state))
        .u8(info.subState)
        .u8(info.status)
        .u8(info.data ? 1 : 0);
}

//   byte  width  0x5072, 20 bytes
//   19    8      discontinuous transmission used
void encode(const Dtx& dtx, ByteBuffer& out) {
    constexpr std::size_t kUsedOffset = 19;
    RecordWriter(out, 0x5072).padTo(kUsedOffset).u8(dtx.used ? 1 : 0);
}

//   byte  width  0x51F8
//   13    8      hopping sequence number
//   14    8      number of frequencies
//   15    16     each ARFCN
void encode(const MobileAllocation& allocation, ByteBuffer& out) {
    RecordWriter record(out, 0x51F8);
    record.u8(allocation.hoppingSequence);
    record.u8(static_cast<unsigned>(allocation.arfcns.size()));
    for (const unsigned arfcn : allocation.arfcns) {
        record.u16(arfcn);
    }
}

} // namespace pallax::gsm
