#include "simulator/RecordWriter.h"
#include "simulator/cdma/CdmaRecords.h"

namespace pallax::cdma {

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

} // namespace pallax::cdma
