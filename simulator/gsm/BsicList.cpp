#include "simulator/RecordWriter.h"
#include "simulator/gsm/GsmRecords.h"

namespace pallax::gsm {

//   byte  width  0x51FF
//   14    8      number of cells
//   15    32     each cell: ARFCN (16), BSIC (8), a byte more
void encode(const BsicList& list, ByteBuffer& out) {
    RecordWriter record(out, 0x51FF);
    record.u8(0).u8(static_cast<unsigned>(list.cells.size()));
    for (const NeighbourBsic& cell : list.cells) {
        record.u16(cell.arfcn).u8(cell.bsic).u8(0);
    }
}

} // namespace pallax::gsm
