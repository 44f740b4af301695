#include "simulator/RecordWriter.h"
#include "simulator/gsm/GsmRecords.h"

namespace pallax::gsm {

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

} // namespace pallax::gsm
