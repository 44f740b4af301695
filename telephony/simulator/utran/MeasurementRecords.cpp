#include "telephony/simulator/RecordWriter.h"
#include "telephony/simulator/utran/UtranRecords.h"

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

//   byte       bit  width  0xD00C
//   14         6    6      number T of transport channels
//   15         4    4      number of composite channels
//   17         0    16     each transport channel: identity (8), block errors (8)
//   289 + 34T  0    64     each composite channel: identity (8), time slot (8), six ratios (8)
void encode(const ChannelQuality& quality, ByteBuffer& out) {
    constexpr std::size_t kTransportStart = 17;
    constexpr std::size_t kCompositeStart = 289;
    constexpr std::size_t kTransportRoom = 34;
    RecordWriter record(out, 0xD00C);
    record.u8(1).padTo(kTransportStart);
    record.bits(14, 6, 6, static_cast<unsigned>(quality.transport.size()));
    record.bits(15, 4, 4, static_cast<unsigned>(quality.composite.size()));
    for (const TransportChannel& channel : quality.transport) {
        record.u8(channel.id).u8(channel.blockErrors);
    }
    record.padTo(kCompositeStart + kTransportRoom * quality.transport.size());
    for (const CompositeChannel& channel : quality.composite) {
        record.u8(channel.id).u8(channel.timeSlot);
        for (const unsigned ratio : channel.ratios) {
            record.u8(ratio);
        }
    }
}

} // namespace pallax::utran
