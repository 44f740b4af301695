#include "simulator/RecordWriter.h"
#include "simulator/gsm/NetworkRecords.h"

namespace pallax::gsm {

//   byte  width  0x7132, 16 bytes
//   13    8      service state
//   14    8      selection mode of the network
void encode(const Registration& registration, ByteBuffer& out) {
    constexpr std::size_t kLength = 16;
    RecordWriter(out, 0x7132)
        .u8(static_cast<unsigned>(registration.state))
        .u8(registration.selectionMode)
        .padTo(kLength);
}

} // namespace pallax::gsm
