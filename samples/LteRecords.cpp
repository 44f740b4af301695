#include "samples/LteRecords.h"

#include "platform/TelephonyConstants.h"
#include "tests/doubles/RecordBuilder.h"

namespace pallax {

namespace {

using doubles::Record;

constexpr unsigned kBand = 3;
constexpr unsigned kUplinkDistance = 18000;

/// Bytes of which fields take some bits each, the low bits in the lower bytes.
class PackedBytes {
public:
    explicit PackedBytes(std::size_t length) : _bytes(length) {}

    PackedBytes& put(std::size_t byte, unsigned bit, unsigned width, int value) {
        for (unsigned index = 0; index < width; ++index) {
            const std::size_t place = byte * 8 + bit + index;
            const unsigned set = static_cast<unsigned>(value) >> index & 1U;
            _bytes.at(place / 8) = static_cast<std::uint8_t>(_bytes[place / 8] | set << place % 8);
        }
        return *this;
    }
    const ByteBuffer& bytes() const { return _bytes; }

private:
    ByteBuffer _bytes;
};

// Raw values of levels: quarters or halves of a decibel above the lowest one.
int rawRsrp(const LteCell& cell) {
    return cell.rsrp_quarterDbm + 140 * 4;
}
int rawRsrq(const LteCell& cell) {
    return cell.rsrq_quarterDb + 30 * 4;
}
/// In halves of a decibel. The whole carrier is that much stronger than one of its tones.
int rawRssi(const LteCell& cell) {
    constexpr int kCarrierAboveTone_db = 28;
    return (cell.rsrp_quarterDbm / 4 + kCarrierAboveTone_db + 140) * 2;
}
/// Level above what the cell asks for, in dB; at least 0.
int levelMargin_db(const LteCell& cell, int required_dbm) {
    const int margin_db = cell.rsrp_quarterDbm / 4 - required_dbm;
    return margin_db > 0 ? margin_db : 0;
}

constexpr int kRequiredDbm = -124;
constexpr int kRawRequired = (kRequiredDbm + 140) / 2;
constexpr int kSrxlevOffsetDb = 30;

Record candidatesHead(const LteCell& serving, unsigned count) {
    return Record(0xB186).u8(1).u8(0).u16(serving.earfcn).u16(serving.physicalCellId).u16(count);
}

} // namespace

ByteBuffer lteIdentityRecord(const LteCell& cell, unsigned cellIdentity, unsigned trackingArea) {
    constexpr unsigned kResourceBlocks = 100;
    return Record(0xB0C2)
        .u8(2)
        .u16(cell.physicalCellId)
        .u16(cell.earfcn)
        .u16(cell.earfcn + kUplinkDistance)
        .u8(kResourceBlocks)
        .u8(kResourceBlocks)
        .u32(cellIdentity)
        .u16(trackingArea)
        .u32(kBand)
        .padTo(38)
        .prefixed();
}

ByteBuffer lteAntennasRecord(unsigned count) {
    return Record(0xB0C1).padTo(20).u8(count).u8(0).prefixed();
}

ByteBuffer idleServingRecord(const LteCell& cell, bool searchesOtherFrequencies) {
    constexpr int kPowerClass_dbm = 23;
    PackedBytes packed(20); // from byte 13 of the record on
    packed.put(0, 0, 8, 3);
    packed.put(4, 0, 16, static_cast<int>(cell.earfcn));
    packed.put(6, 0, 9, static_cast<int>(cell.physicalCellId)).put(7, 1, 4, 5);
    packed.put(8, 0, 9, rawRsrp(cell)).put(9, 1, 9, rawRsrp(cell) - 1);
    packed.put(10, 2, 7, rawRsrq(cell)).put(11, 1, 7, rawRsrq(cell));
    packed.put(12, 0, 9, rawRssi(cell));
    packed.put(13, 1, 6, kRawRequired);
    packed.put(13, 7, 7, kPowerClass_dbm + 30).put(14, 6, 6, kPowerClass_dbm + 30);
    packed.put(16, 0, 7, levelMargin_db(cell, kRequiredDbm) + kSrxlevOffsetDb);
    packed.put(16, 7, 6, 0);
    packed.put(17, 5, 6, 31).put(18, 3, 6, searchesOtherFrequencies ? 4 : 32);
    packed.put(19, 1, 1, searchesOtherFrequencies ? 1 : 0).put(19, 2, 4, 2);
    return Record(0xB17F).append(packed.bytes()).prefixed();
}

ByteBuffer idleNeighboursRecord(unsigned earfcn, const std::vector<LteCell>& cells) {
    PackedBytes head(8); // from byte 13 of the record on
    head.put(0, 0, 8, 3).put(4, 0, 16, static_cast<int>(earfcn)).put(6, 0, 6, kRawRequired);
    head.put(6, 6, 5, static_cast<int>(cells.size()) - 1);
    Record record(0xB180);
    record.append(head.bytes());
    for (const LteCell& cell : cells) {
        PackedBytes entry(20);
        entry.put(0, 0, 9, static_cast<int>(cell.physicalCellId));
        entry.put(1, 1, 8, rawRssi(cell));
        entry.put(2, 1, 9, rawRsrp(cell) / 2).put(4, 0, 9, rawRsrp(cell) / 2 - 1); // half dB steps
        entry.put(5, 1, 7, rawRsrq(cell)).put(6, 0, 7, rawRsrq(cell));
        entry.put(6, 7, 7, levelMargin_db(cell, kRequiredDbm) + kSrxlevOffsetDb);
        entry.put(8, 0, 16, 20 + static_cast<int>(cell.physicalCellId % 7));
        entry.put(12, 0, 11, static_cast<int>(cell.physicalCellId * 3));
        entry.put(13, 3, 19, static_cast<int>(cell.physicalCellId * 1021));
        record.append(entry.bytes());
    }
    return record.prefixed();
}

ByteBuffer connectedRecord(const LteCell& serving, unsigned subframe,
                           const std::vector<LteCell>& measured,
                           const std::vector<unsigned>& detected) {
    // Qualities are in eighths of a decibel above -20 dB here.
    const auto rsrq = [](const LteCell& cell) {
        return static_cast<unsigned>((cell.rsrq_quarterDb + 20 * 4) * 2);
    };
    const auto rsrp = [](const LteCell& cell) { return static_cast<unsigned>(rawRsrp(cell)); };
    Record record(0xB179);
    record.u32(1).u16(serving.earfcn).u16(serving.physicalCellId).u16(subframe);
    record.u16(rsrp(serving)).u16(rsrq(serving));
    record.u8(static_cast<unsigned>(measured.size())).u8(static_cast<unsigned>(detected.size()));
    for (const LteCell& cell : measured) {
        record.u16(cell.physicalCellId).u16(rsrp(cell)).u16(rsrq(cell));
    }
    for (const unsigned cell : detected) {
        record.u16(cell);
    }
    return record.prefixed();
}

ByteBuffer candidateRecord(const LteCell& serving, const Candidate& candidate) {
    return candidatesHead(serving, 1)
        .u16(candidate.priority)
        .u16(static_cast<unsigned>(candidate.technology))
        .u16(candidate.frequency)
        .u16(candidate.cell)
        .prefixed();
}

ByteBuffer cdmaCandidateRecord(const LteCell& serving, unsigned priority, bool hrpd, unsigned band,
                               unsigned channel, unsigned pilot) {
    const auto technology =
        hrpd ? Candidate::Technology::CdmaHrpd : Candidate::Technology::Cdma1xRtt;
    return candidatesHead(serving, 1)
        .u16(priority)
        .u16(static_cast<unsigned>(technology))
        .u8(band)
        .append({0, 0, 0})
        .u16(channel)
        .u16(pilot)
        .prefixed();
}

ByteBuffer candidateChainRecord(const LteCell& serving, unsigned earfcn, unsigned arfcn,
                                unsigned bsic) {
    constexpr unsigned kGsm900 = 8;
    return candidatesHead(serving, 2)
        .u16(6)
        .u16(static_cast<unsigned>(Candidate::Technology::Lte))
        .u16(earfcn)
        .u16(static_cast<unsigned>(Candidate::Technology::Geran))
        .u16(arfcn)
        .u8(kGsm900)
        .u8(bsic)
        .prefixed();
}

PropertyList lteCellEntry(const LteCell& cell, bool serving, unsigned cellIdentity,
                          unsigned trackingArea) {
    Dictionary entry;
    const auto number = [&](std::string_view key, std::int64_t value) {
        entry.setFixed(key, PropertyList::integer(value));
    };
    entry.setFixed(kHXCellMonitorCellRadioAccessTechnology,
                   Text::fixed(kHXCellMonitorRadioAccessTechnologyLTE));
    entry.setFixed(kHXCellMonitorCellType, Text::fixed(serving ? kHXCellMonitorCellTypeServing
                                                               : kHXCellMonitorCellTypeNeighbor));
    number(kHXCellMonitorPID, cell.physicalCellId);
    number(kHXCellMonitorUARFCN, cell.earfcn);
    if (serving) {
        number(kHXCellMonitorTAC, trackingArea);
        number(kHXCellMonitorCellId, cellIdentity);
        number(kHXCellMonitorBandInfo, kBand);
    }
    return entry;
}

} // namespace pallax
