#include "simulator/RecordWriter.h"
#include "simulator/gsm/UmtsRecords.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace pallax::gsm {

namespace {

/// Linear energies for each whole dB below full scale, each in the middle of its dB.
std::uint32_t energyOf(int ecno_db) {
    static constexpr int kSteps = 23;
    static const auto energies = [] {
        constexpr double kFullScale = 524288;
        constexpr double kHalfBand = 0.45; // in dB, inside the band
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

} // namespace pallax::gsm
