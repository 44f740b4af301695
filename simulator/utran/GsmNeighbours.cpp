#include "simulator/RecordWriter.h"
#include "simulator/utran/UtranRecords.h"

namespace pallax::utran {

//   byte  bit  width  0xD00E
//   16    0    8      number of cells
//   17    0    64     each cell: number (14), band (1), BSIC valid (1), NCC (8), BCC (8), ARFCN
//                     (16), RSSI (16)
void encode(std::span<const GsmNeighbour> cells, ByteBuffer& out) {
    constexpr std::size_t kCountOffset = 16;
    constexpr unsigned kBandShift = 14;
    constexpr unsigned kBsicValidShift = 15;
    RecordWriter record(out, 0xD00E);
    record.padTo(kCountOffset).u8(static_cast<unsigned>(cells.size()));
    for (const GsmNeighbour& cell : cells) {
        record.u16(cell.number | cell.bandIndicator << kBandShift |
                   (cell.bsicValid ? 1U : 0U) << kBsicValidShift);
        record.u8(cell.ncc).u8(cell.bcc).u16(cell.arfcn).s16(cell.rssi_dbm);
    }
}

} // namespace pallax::utran
