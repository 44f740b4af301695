#include "samples/UtranRecords.h"

#include "platform/TelephonyConstants.h"
#include "tests/doubles/RecordBuilder.h"

namespace pallax {

namespace {

using doubles::Record;

constexpr unsigned kKnownVersion = 1;
constexpr unsigned kBand = 34;

Dictionary entryOf(std::string_view cellType, unsigned uarfcn, unsigned scramblingCode) {
    Dictionary entry;
    entry.setFixed(kHXCellMonitorCellRadioAccessTechnology,
                   Text::fixed(kHXCellMonitorRadioAccessTechnologyUTRAN2));
    entry.setFixed(kHXCellMonitorCellType, Text::fixed(cellType));
    entry.setFixed(kHXCellMonitorUARFCN, PropertyList::integer(uarfcn));
    entry.setFixed(kHXCellMonitorSCN, PropertyList::integer(scramblingCode));
    return entry;
}

} // namespace

ByteBuffer rrcModeRecord(RrcMode mode) {
    return Record(0xD0E0).u8(kKnownVersion).u8(static_cast<unsigned>(mode)).prefixed();
}

ByteBuffer utranServingRecord(const UtranServing& cell) {
    return Record(0xD0E2)
        .u8(kKnownVersion)
        .u8(0) // access restrictions: none
        .u8(cell.ura)
        .u8(0)
        .u16(cell.uarfcn)
        .u16(cell.uarfcn)
        .u32(cell.cellId)
        .u8(0) // all calls
        .prefixed();
}

ByteBuffer utranNeighboursRecord(const std::vector<UtranNeighbour>& cells) {
    constexpr std::size_t kCellsStart = 168;
    constexpr std::size_t kCellLength = 16;
    Record record(0xD00A);
    record.padTo(16).u8(static_cast<unsigned>(cells.size()) << 1U).padTo(kCellsStart);
    for (const UtranNeighbour& cell : cells) {
        record.u32(cell.uarfcn | cell.cellParameter << 14U | cell.filterRscp << 21U |
                   static_cast<unsigned>(cell.set) << 29U |
                   (cell.inDetectedCellSearch ? 1U : 0U) << 31U);
        record.padTo(record.bytes().size() + kCellLength - 4);
    }
    return record.prefixed();
}

ByteBuffer utranGsmNeighboursRecord(const std::vector<GsmCell>& cells) {
    constexpr unsigned kBsicValid = 0x8000;
    Record record(0xD00E);
    record.padTo(16).u8(static_cast<unsigned>(cells.size()));
    unsigned number = 0;
    for (const GsmCell& cell : cells) {
        record.u16(number++ | kBsicValid).u8(cell.bsic >> 3U).u8(cell.bsic & 7U);
        record.u16(cell.arfcn).s16(cell.rxLevel_dbm);
    }
    return record.prefixed();
}

ByteBuffer channelQualityRecord(const std::vector<TransportChannel>& transport,
                                const std::vector<CompositeChannel>& composite) {
    // The composite channels have their fixed place, far behind the transport channels.
    const std::size_t compositeStart = 289 + 34 * transport.size();
    Record record(0xD00C);
    record.u8(kKnownVersion);
    record.u16(static_cast<unsigned>(transport.size()) << 6U |
               static_cast<unsigned>(composite.size()) << 12U);
    record.u8(0);
    for (const TransportChannel& channel : transport) {
        record.u8(channel.id).u8(channel.blockErrors);
    }
    record.padTo(compositeStart);
    for (const CompositeChannel& channel : composite) {
        record.u8(channel.id).u8(channel.timeSlot);
        for (const unsigned ratio : channel.ratios) {
            record.u8(ratio);
        }
    }
    return record.prefixed();
}

PropertyList utranServingEntry(const UtranServing& cell) {
    Dictionary entry = entryOf(kHXCellMonitorCellTypeServing, cell.uarfcn, cell.scramblingCode);
    entry.setFixed(kHXCellMonitorLAC, PropertyList::integer(cell.lac));
    entry.setFixed(kHXCellMonitorCellId, PropertyList::integer(cell.cellId));
    entry.setFixed(kHXCellMonitorBandInfo, PropertyList::integer(kBand));
    return entry;
}

PropertyList utranNeighbourEntry(const UtranNeighbour& cell) {
    return entryOf(kHXCellMonitorCellTypeNeighbor, cell.uarfcn, cell.cellParameter);
}

} // namespace pallax
