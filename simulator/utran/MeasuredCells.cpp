#include "simulator/RecordWriter.h"
#include "simulator/utran/UtranRecords.h"

namespace pallax::utran {

//   byte  bit  width  0xD00A
//   16    1    7      number of cells
//   168   0    128    each cell: UARFCN (14), cell parameter (7), filtered RSCP (8), set (2), in
//                     detected-cell search (1), 12 bytes more
void encode(std::span<const MeasuredCell> cells, ByteBuffer& out) {
    constexpr std::size_t kCountOffset = 16;
    constexpr std::size_t kCellsStart = 168;
    constexpr std::size_t kRestOfCell = 12;
    constexpr unsigned kParameterShift = 14;
    constexpr unsigned kRscpShift = 21;
    constexpr unsigned kSetShift = 29;
    constexpr unsigned kSearchShift = 31;
    RecordWriter record(out, 0xD00A);
    record.padTo(kCellsStart);
    record.bits(kCountOffset, 1, 7, static_cast<unsigned>(cells.size()));
    for (const MeasuredCell& cell : cells) {
        record.u32(cell.uarfcn | cell.cellParameter << kParameterShift |
                   cell.filteredRscp << kRscpShift | static_cast<unsigned>(cell.set) << kSetShift |
                   (cell.inDetectedCellSearch ? 1U : 0U) << kSearchShift);
        record.skip(kRestOfCell);
    }
}

} // namespace pallax::utran
