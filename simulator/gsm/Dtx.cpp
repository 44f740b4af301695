#include "simulator/RecordWriter.h"
#include "simulator/gsm/GsmRecords.h"

namespace pallax::gsm {

//   byte  width  0x5072, 20 bytes
//   19    8      discontinuous transmission used
void encode(const Dtx& dtx, ByteBuffer& out) {
    constexpr std::size_t kUsedOffset = 19;
    RecordWriter(out, 0x5072).padTo(kUsedOffset).u8(dtx.used ? 1 : 0);
}

} // namespace pallax::gsm
