#include "simulator/RecordWriter.h"
#include "simulator/gsm/GsmRecords.h"

namespace pallax::gsm {

//   byte  width  0x5134, 26 bytes
//   13    16     ARFCN
//   15    16     BSIC
//   17    16     cell identity
void encode(const ServingIdentity& identity, ByteBuffer& out) {
    constexpr std::size_t kLength = 26;
    RecordWriter(out, 0x5134)
        .u16(identity.arfcn)
        .u16(identity.bsic)
        .u16(identity.cellId)
        .padTo(kLength);
}

} // namespace pallax::gsm
