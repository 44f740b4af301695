#include "telephony/simulator/RecordWriter.h"
#include "telephony/simulator/gsm/UmtsRecords.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace pallax::gsm {

namespace {

/// Linear energies for each whole dB below full scale, each in the middle of what is read as that
/// dB.
std::uint32_t energyOf(int ecno_db) {
    static constexpr int kSteps = 23;
    static const auto energies = [] {
        constexpr double kFullScale = 524288;
        constexpr double kHalfBand = 0.45; // of a dB, inside of the band
        std::array<std::uint32_t, kSteps> table{};
        for (std::size_t below = 1; below < table.size(); ++below) {
            table[below] = static_cast<std::uint32_t>(
                kFullScale * std::pow(10.0, -(static_cast<double>(below) - kHalfBand) / 10));
        }
        table[0] = static_cast<std::uint32_t>(kFullScale);
        return table;
    }();
    return energies[static_cast<std::size_t>(std::clamp(-ecno_db, 0, kSteps - 1))];
}

constexpr int kTenths = 10;
constexpr int kAgcOffset = 512;

} // namespace

//   byte       width  0x417A, N cells
//   13         16     receive AGC: tenths of a dB above -106 dBm, less 512
//   15         8      N
//   16         120    each cell: byte 7 scrambling code (13 bits), set (3 bits)
//   16 + 15N   352    each cell: eleven words, of which the ninth is its energy
void encode(const Searcher& searcher, ByteBuffer& out) {
    constexpr int kLeastCarrierDbm = -106;
    constexpr unsigned kMonitored = 1;
    constexpr unsigned kSetShift = 13;
    constexpr std::size_t kBeforeCode = 7;
    constexpr std::size_t kAfterCode = 6;
    constexpr std::size_t kBeforeEnergy = 32;
    constexpr std::size_t kAfterEnergy = 8;
    RecordWriter record(out, 0x417A);
    record.s16((searcher.carrier_dbm - kLeastCarrierDbm) * kTenths - kAgcOffset);
    record.u8(static_cast<unsigned>(searcher.cells.size()));
    for (const SearchedCell& cell : searcher.cells) {
        record.skip(kBeforeCode);
        record.u16(cell.scramblingCode | (cell.active ? 0 : kMonitored) << kSetShift);
        record.skip(kAfterCode);
    }
    for (const SearchedCell& cell : searcher.cells) {
        record.skip(kBeforeEnergy).u32(energyOf(cell.ecno_db)).skip(kAfterEnergy);
    }
}

//   byte  width  0x4005
//   13    8      number of UMTS cells
//   14    8      number of GSM cells
//   15    80     each UMTS cell: UARFCN (16), scrambling code (16), RSCP + 21 (8), RSCP (16),
//                Ec/No in halves of a dB (8), ranking value (16)
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

//   15    56     each GSM cell: ARFCN (16), BSIC (16), level (8), ranking value (16)
void encode(std::span<const RankedGsmCell> ranking, ByteBuffer& out) {
    RecordWriter record(out, 0x4005);
    record.u8(0).u8(static_cast<unsigned>(ranking.size()));
    for (const RankedGsmCell& cell : ranking) {
        record.u16(cell.arfcn).u16(cell.bsic).s8(cell.level_dbm).s16(cell.rank);
    }
}

//   byte  width  0x4127, 29 bytes
//   13    32     uplink UARFCN
//   17    32     downlink UARFCN
//   21    32     cell identity
//   25    16     URA identity
void encode(const UmtsIdentity& identity, ByteBuffer& out) {
    constexpr std::size_t kLength = 29;
    RecordWriter(out, 0x4127)
        .u32(identity.uplinkUarfcn)
        .u32(identity.downlinkUarfcn)
        .u32(identity.cellId)
        .u16(identity.ura)
        .padTo(kLength);
}

} // namespace pallax::gsm
