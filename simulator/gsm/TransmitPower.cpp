#include "simulator/RecordWriter.h"
#include "simulator/gsm/UmtsRecords.h"

namespace pallax::gsm {

//   byte  width  0x4031
//   14    8      number of slots
//   16    112    each slot: byte 4 the power, tenths of a dB above -70 dBm, less 512 (16)
void encode(const TransmitPower& power, ByteBuffer& out) {
    constexpr int kLeastDbm = -70;
    constexpr int kTenthsPerDb = 10;
    constexpr int kOffset = 512;
    constexpr std::size_t kBefore = 4;
    constexpr std::size_t kAfter = 8;
    RecordWriter record(out, 0x4031);
    record.u8(0).u8(static_cast<unsigned>(power.slots_dbm.size())).u8(0);
    for (const int slot_dbm : power.slots_dbm) {
        record.skip(kBefore).s16((slot_dbm - kLeastDbm) * kTenthsPerDb - kOffset).skip(kAfter);
    }
}

} // namespace pallax::gsm
