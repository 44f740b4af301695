#include "simulator/RecordWriter.h"
#include "simulator/gsm/GsmRecords.h"

namespace pallax::gsm {

//   byte  width  0x51F8
//   13    8      hopping sequence number
//   14    8      number of frequencies
//   15    16     each ARFCN
void encode(const MobileAllocation& allocation, ByteBuffer& out) {
    RecordWriter record(out, 0x51F8);
    record.u8(allocation.hoppingSequence);
    record.u8(static_cast<unsigned>(allocation.arfcns.size()));
    for (const unsigned arfcn : allocation.arfcns) {
        record.u16(arfcn);
    }
}

} // namespace pallax::gsm
