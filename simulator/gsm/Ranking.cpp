#include "simulator/RecordWriter.h"
#include "simulator/gsm/UmtsRecords.h"

namespace pallax::gsm {

//   byte  width  0x4005
//   13    8      number of UMTS cells
//   14    8      number of GSM cells
//   15    80     each UMTS cell: UARFCN (16), scrambling code (16), RSCP + 21 (8), RSCP (16),
//                Ec/No in halves of a dB (8), ranking value (16); or, in the same place,
//   15    56     each GSM cell: ARFCN (16), BSIC (16), level (8), ranking value (16)
void encode(std::span<const RankedUmtsCell> ranking, ByteBuffer& out) {
    constexpr int kRscpOffset = 21;
    constexpr double kStepDb = 0.5;
    RecordWriter record(out, 0x4005);
    record.u8(static_cast<unsigned>(ranking.size())).u8(0);
    for (const RankedUmtsCell& cell : ranking) {
        record.u16(cell.uarfcn).u16(cell.scramblingCode);
        record.s8(cell.rscp_dbm + kRscpOffset).s16(cell.rscp_dbm);
        record.s8(static_cast<int>(cell.ecno_db / kStepDb)).s16(cell.rank);
    }
}

void encode(std::span<const RankedGsmCell> ranking, ByteBuffer& out) {
    RecordWriter record(out, 0x4005);
    record.u8(0).u8(static_cast<unsigned>(ranking.size()));
    for (const RankedGsmCell& cell : ranking) {
        record.u16(cell.arfcn).u16(cell.bsic).s8(cell.level_dbm).s16(cell.rank);
    }
}

} // namespace pallax::gsm
