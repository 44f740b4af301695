#include "simulator/RecordWriter.h"
#include "simulator/gsm/GsmRecords.h"

namespace pallax::gsm {

//   byte  width  0x51F4, 15 bytes
//   14    8      position: broadcast channel (0) or the extended one (1)
void encode(const Si13Position& position, ByteBuffer& out) {
    RecordWriter(out, 0x51F4).u8(0).u8(position.extended ? 1 : 0);
}

} // namespace pallax::gsm
