#include "simulator/Measurement.h"
#include "simulator/RecordWriter.h"
#include "simulator/lte/LteRecords.h"

namespace pallax::lte {

namespace {

//   byte  bit  width  entry, 20 bytes
//   0     0    9      physical cell ID
//   1     1    8      RSSI, halves of a dB above -140 dBm
//   2     1    9      measured RSRP, the same
//   4     0    9      average RSRP, the same
//   5     1    7      measured RSRQ, quarters of a dB above -30 dB
//   6     0    7      average RSRQ, the same
//   6     7    7      Srxlev, dB above -30
//   8     0    16     frequency offset
//   12    0    11     frame offset
//   13    3    19     sample offset
constexpr std::size_t kEntryLength = 20;

void putEntry(RecordWriter& record, const IdleNeighbour& cell) {
    const std::size_t start = record.length();
    record.skip(kEntryLength);
    record.bits(start, 0, 9, cell.physicalCellId);
    record.bits(start + 1, 1, 8, rawOf(cell.rssi_dbm, -140, 0.5, 8));
    record.bits(start + 2, 1, 9, rawOf(cell.rsrp_dbm, -140, 0.5, 9));
    record.bits(start + 4, 0, 9, rawOf(cell.averageRsrp_dbm, -140, 0.5, 9));
    record.bits(start + 5, 1, 7, rawOf(cell.rsrq_db, -30, 0.25, 7));
    record.bits(start + 6, 0, 7, rawOf(cell.averageRsrq_db, -30, 0.25, 7));
    record.bits(start + 6, 7, 7, rawOf(cell.srxlev_db, -30, 1, 7));
    record.bits(start + 8, 0, 16, cell.frequencyOffset);
    record.bits(start + 12, 0, 11, cell.frameOffset);
    record.bits(start + 13, 3, 19, cell.sampleOffset);
}

} // namespace

//   byte  bit  width  0xB180
//   13    0    8      version
//   17    0    16     EARFCN
//   19    0    6      Qrxlevmin, steps of 2 dB above -140 dBm
//   19    6    5      number of cells less one
//   21                entries
void encode(const IdleNeighbours& neighbours, ByteBuffer& out) {
    constexpr unsigned kVersion = 3;
    constexpr std::size_t kEntriesStart = 21;
    RecordWriter record(out, 0xB180);
    record.u8(kVersion).padTo(kEntriesStart);
    record.bits(17, 0, 16, neighbours.earfcn);
    record.bits(19, 0, 6, rawOf(neighbours.qrxlevmin_dbm, -140, 2, 6));
    record.bits(19, 6, 5, static_cast<unsigned>(neighbours.cells.size()) - 1);
    for (const IdleNeighbour& cell : neighbours.cells) {
        putEntry(record, cell);
    }
}

} // namespace pallax::lte
