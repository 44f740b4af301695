#include "simulator/RecordWriter.h"
#include "simulator/gsm/UmtsRecords.h"

namespace pallax::gsm {

//   byte  width  0x4127, 29 bytes
//   13    32     uplink UARFCN
//   17    32     downlink UARFCN
//   21    32     cell identity
//   25    16     URA identity
void encode(const UmtsIdentity& identity, ByteBuffer& out) {
    constexpr std::size_t kLength = 29;
    RecordWriter(out, 0x4127)
        .u32(identity.uplinkUarfcn)
        .u32(identity.downlinkUarfcn)
        .u32(identity.cellId)
        .u16(identity.ura)
        .padTo(kLength);
}

} // namespace pallax::gsm
