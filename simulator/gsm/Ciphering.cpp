#include "simulator/RecordWriter.h"
#include "simulator/gsm/UmtsRecords.h"

namespace pallax::gsm {

//   byte  width  0x4157, 19 bytes
//   13    8      ciphering enabled
void encode(const Ciphering& ciphering, ByteBuffer& out) {
    constexpr std::size_t kLength = 19;
    RecordWriter(out, 0x4157).u8(ciphering.enabled ? 1 : 0).padTo(kLength);
}

} // namespace pallax::gsm
