#include "samples/DriveRecords.h"

#include "platform/TelephonyConstants.h"
#include "plist/PropertyListCodec.h"
#include "tests/doubles/RecordBuilder.h"

#include <stdexcept>

namespace pallax {

namespace {

using doubles::Record;

constexpr unsigned kMobileCountryCode = 262;
constexpr unsigned kMobileNetworkCode = 42;

/// A linear energy at this many whole dB below full scale.
unsigned energyOf(int ecno_db) {
    constexpr double kFullScale = 524288.0;
    constexpr double kOneDecibelDown = 0.7943;
    // In the middle of the band, so that the last bit of a multiplication does not matter.
    double energy = kFullScale * 0.89;
    for (int step = 1; step < -ecno_db; ++step) {
        energy *= kOneDecibelDown;
    }
    return static_cast<unsigned>(energy);
}

/// The receive AGC with which the searcher shows the level of the first cell; 0 without a cell.
int agcOf(const std::vector<UmtsCell>& cells) {
    if (cells.empty()) {
        return 0;
    }
    const UmtsCell& cell = cells.front();
    return (cell.rscp_dbm - cell.ecno_db + 106) * 10 - 512;
}

} // namespace

ByteBuffer plainRecord(unsigned logCode, const std::vector<unsigned>& payload, std::size_t length) {
    Record record(logCode);
    for (const unsigned byte : payload) {
        record.u8(byte);
    }
    return record.padTo(length).prefixed();
}

ByteBuffer servingPlmnRecord(unsigned lac, unsigned rac) {
    return Record(0x7135)
        .u8(1)                      // network operating mode
        .u8(3)                      // service type: both domains
        .append({0x62, 0xF2, 0x24}) // 262 42
        .u8(lac >> 8U)              // location area code, high byte first
        .u8(lac)
        .u8(rac)
        .padTo(32)
        .prefixed();
}

ByteBuffer equivalentPlmnRecord() {
    // The digits of country and network alternate: 262 and 020. Only one entry, because entries are
    // 3 bytes apart but read 6 bytes long, so a second one would share half of these digits.
    return Record(0x7150).padTo(16).u8(1).append({2, 0, 6, 2, 2, 0}).prefixed();
}

ByteBuffer searcherRecord(const std::vector<UmtsCell>& cells) {
    constexpr unsigned kMonitored = 1;
    Record record(0x417A);
    record.s16(agcOf(cells)).u8(static_cast<unsigned>(cells.size()));
    for (std::size_t index = 0; index < cells.size(); ++index) {
        const unsigned set = index == 0 ? 0 : kMonitored;
        record.append({0, 0, 0, 0, 0, 0, 0});
        record.u16(cells[index].scramblingCode | set << 13U);
        record.append({0, 0, 0, 0, 0, 0});
    }
    for (const UmtsCell& cell : cells) {
        for (int word = 0; word < 8; ++word) {
            record.u32(0);
        }
        record.u32(energyOf(cell.ecno_db)).u32(0).u32(0);
    }
    return record.prefixed();
}

ByteBuffer rankingRecord(const std::vector<UmtsCell>& umts, const std::vector<GsmCell>& gsm) {
    Record record(0x4005);
    record.u8(static_cast<unsigned>(umts.size())).u8(static_cast<unsigned>(gsm.size()));
    for (const UmtsCell& cell : umts) {
        record.s16(static_cast<int>(cell.uarfcn)).u16(cell.scramblingCode);
        record.s8(cell.rscp_dbm + 21).s16(cell.rscp_dbm).s8(cell.ecno_db * 2);
        record.s16(cell.rscp_dbm + 115);
    }
    if (umts.empty()) {
        for (const GsmCell& cell : gsm) {
            record.u16(cell.arfcn).u16(cell.bsic).s8(cell.rxLevel_dbm);
            record.s16(cell.rxLevel_dbm + 105);
        }
    }
    return record.prefixed();
}

ByteBuffer umtsIdentityRecord(unsigned uarfcn, unsigned cellId, unsigned ura) {
    constexpr unsigned kDuplexDistance = 950;
    return Record(0x4127)
        .u32(uarfcn - kDuplexDistance)
        .u32(uarfcn)
        .u32(cellId)
        .u16(ura)
        .padTo(29)
        .prefixed();
}

ByteBuffer transmitPowerRecord(int power_dbm) {
    const int raw = (power_dbm + 70) * 10 - 512;
    Record record(0x4031);
    record.u8(0).u8(2).u8(0);
    for (const int sample : {raw, raw + 10}) {
        record.append({0, 0, 0, 0}).s16(sample).append({0, 0, 0, 0, 0, 0, 0, 0});
    }
    return record.prefixed();
}

ByteBuffer blerRecord(unsigned window, unsigned received, unsigned errors) {
    return Record(0x4116)
        .u8(2)
        .u16(window)
        .u8(1)
        .u32(received)
        .u32(errors)
        .u8(2)
        .u32(received / 2)
        .u32(errors / 2)
        .prefixed();
}

ByteBuffer hsdpaRecord(unsigned subFrames, unsigned receivedBits, unsigned errors,
                       Carriers carriers) {
    constexpr unsigned kPrimary = 2;
    constexpr unsigned kDualCarrier = 2; // above the ten bits of the sub-frames
    constexpr std::size_t kSecondaryStart = 18 + 162 * kPrimary;
    const bool dual = carriers == Carriers::Two;
    Record record(0x4221);
    record.u8(1).u16(subFrames | (dual ? kDualCarrier << 10U : 0U)).u8(kPrimary).u8(dual ? 1 : 0);
    const auto process = [&](unsigned identity, unsigned bits) {
        record.u8(identity).u32(bits).u16(subFrames / 2).u16(errors);
    };
    for (unsigned identity = 0; identity < kPrimary; ++identity) {
        process(identity, receivedBits + identity * 640);
    }
    if (dual) {
        record.padTo(kSecondaryStart);
        process(0, receivedBits / 2);
    }
    return record.prefixed();
}

ByteBuffer gsmIdentityRecord(const GsmCell& cell, unsigned cellId) {
    return Record(0x5134).u16(cell.arfcn).u16(cell.bsic).u16(cellId).padTo(26).prefixed();
}

ByteBuffer gsmMeasurementRecord(const GsmCell& serving, const std::vector<GsmCell>& neighbours) {
    const auto level = [](const GsmCell& cell) { return static_cast<unsigned>(-cell.rxLevel_dbm); };
    Record record(0x5137);
    record.u8(0).u8(0).u8(level(serving));
    // C1 and C2. "GSM RR Info" shows the same words as its Rx quality, which therefore exceeds the
    // 0 to 7 of a real one.
    record.s32(serving.rxLevel_dbm + 105).s32(serving.rxLevel_dbm + 111);
    record.padTo(26).u8(1).u8(0).u8(static_cast<unsigned>(neighbours.size()));
    for (const GsmCell& cell : neighbours) {
        record.u16(cell.arfcn).u8(level(cell)).s32(cell.rxLevel_dbm + 105);
        record.append({0, 0, 0, 0, 0, 0, 0});
    }
    return record.prefixed();
}

ByteBuffer bsicRecord(const std::vector<GsmCell>& neighbours) {
    Record record(0x51FF);
    record.u8(0).u8(static_cast<unsigned>(neighbours.size()));
    for (const GsmCell& cell : neighbours) {
        record.u16(cell.arfcn).u8(cell.bsic).u8(0);
    }
    return record.prefixed();
}

ByteBuffer propertyListRecordOf(unsigned logCode, const PropertyList& object, ListForm form) {
    Record record(logCode);
    if (form == ListForm::Xml) {
        const auto text = serializeXml(object);
        if (!text) {
            throw std::logic_error(text.error().reason);
        }
        record.append(ByteBuffer(text->begin(), text->end()));
    } else {
        const auto bytes = serializeBinary(object);
        if (!bytes) {
            throw std::logic_error(bytes.error().reason);
        }
        record.append(*bytes);
    }
    return record.prefixed();
}

namespace {

Dictionary cellEntry(std::string_view technology, bool serving, unsigned cellId, unsigned lac) {
    Dictionary entry;
    const auto number = [&](std::string_view key, std::int64_t value) {
        entry.setFixed(key, PropertyList::integer(value));
    };
    entry.setFixed(kHXCellMonitorCellRadioAccessTechnology, Text::fixed(technology));
    entry.setFixed(kHXCellMonitorCellType, Text::fixed(serving ? kHXCellMonitorCellTypeServing
                                                               : kHXCellMonitorCellTypeNeighbor));
    if (serving) {
        number(kHXCellMonitorMCC, kMobileCountryCode);
        number(kHXCellMonitorMNC, kMobileNetworkCode);
        number(kHXCellMonitorLAC, lac);
        number(kHXCellMonitorCellId, cellId);
    }
    return entry;
}

} // namespace

PropertyList umtsCellEntry(const UmtsCell& cell, bool serving, unsigned cellId, unsigned lac) {
    Dictionary entry = cellEntry(kHXCellMonitorRadioAccessTechnologyUMTS, serving, cellId, lac);
    const auto number = [&](std::string_view key, std::int64_t value) {
        entry.setFixed(key, PropertyList::integer(value));
    };
    number(kHXCellMonitorUARFCN, cell.uarfcn);
    number(kHXCellMonitorSCN, cell.scramblingCode);
    number(kHXCellMonitorRSCP, cell.rscp_dbm);
    number(kHXCellMonitorECN0, cell.ecno_db);
    return entry;
}

PropertyList gsmCellEntry(const GsmCell& cell, bool serving, unsigned cellId, unsigned lac) {
    Dictionary entry = cellEntry(kHXCellMonitorRadioAccessTechnologyGSM, serving, cellId, lac);
    entry.setFixed(kHXCellMonitorARFCN, PropertyList::integer(cell.arfcn));
    // In steps of 2 dB.
    entry.setFixed(kHXCellMonitorRSSI, PropertyList::integer(cell.rxLevel_dbm / 2));
    return entry;
}

} // namespace pallax
