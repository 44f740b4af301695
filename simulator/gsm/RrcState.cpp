#include "simulator/RecordWriter.h"
#include "simulator/gsm/UmtsRecords.h"

namespace pallax::gsm {

//   byte  width  0x4125, 14 bytes
//   13    8      state
void encode(RrcState state, ByteBuffer& out) {
    RecordWriter(out, 0x4125).u8(static_cast<unsigned>(state));
}

} // namespace pallax::gsm
