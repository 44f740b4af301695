#include "simulator/RecordWriter.h"
#include "simulator/gsm/GsmRecords.h"

namespace pallax::gsm {

//   byte  width  0x5076, 17 bytes
//   13    16     ARFCN of the dedicated channel
void encode(const DedicatedChannel& channel, ByteBuffer& out) {
    constexpr std::size_t kLength = 17;
    RecordWriter(out, 0x5076).u16(channel.arfcn).padTo(kLength);
}

} // namespace pallax::gsm
