#include "simulator/RecordWriter.h"
#include "simulator/gsm/NetworkRecords.h"

namespace pallax::gsm {

//   byte  width  0x7130, 16 bytes
//   13    8      state
//   14    8      sub-state
//   15    8      status of the routing-area update
void encode(const PacketMobilityState& state, ByteBuffer& out) {
    RecordWriter(out, 0x7130).u8(state.state).u8(state.subState).u8(state.updateStatus);
}

} // namespace pallax::gsm
