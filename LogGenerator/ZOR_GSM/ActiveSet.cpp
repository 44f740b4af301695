#include "LogGenerator/ZOR_GSM/ActiveSet.h"

#include "LogGenerator/Records/Description.h"
#include "LogGenerator/Records/EntryList.h"

#include <algorithm>
#include <array>

namespace pallax {

namespace {

constexpr Position kReceiveAgc = s16At(13);

constexpr std::size_t kCellStride = 15;
constexpr std::size_t kCellBytesRead = 9;
constexpr Position kSetType = bitsAt(8, 5, 3);
constexpr std::int64_t kActive = 0;

constexpr std::size_t kPathLength = 44;
constexpr auto kEnergyOffsets = std::to_array<std::size_t>({32, 36, 40});

constexpr auto kCellFields = std::to_array<Field>({
    {"Scrambling Code", bitsAt(7, 0, 13), Conversion::number()},
});

/// The first energy of the path record that is not 0, or 0.
std::uint32_t energyOf(const LogRecord& path) {
    const auto* const offset =
        std::find_if(kEnergyOffsets.begin(), kEnergyOffsets.end(),
                     [&path](std::size_t candidate) { return path.u32(candidate) != 0; });
    return offset != kEnergyOffsets.end() ? path.u32(*offset) : 0;
}

std::int64_t rscp_db(std::int64_t receiveAgc, std::int64_t ecio_db) {
    constexpr std::int64_t kAgcOffset = 512;
    constexpr std::int64_t kAgcStepsPerDb = 10;
    constexpr std::int64_t kFloorDbm = 106;
    return (receiveAgc + kAgcOffset) / kAgcStepsPerDb - kFloorDbm + ecio_db;
}

} // namespace

Array ActiveSet::cellsOf(const LogRecord& record) const {
    const std::size_t count = cellCount(record);
    const EntryList cells(record, {kCellsStart, kCellStride, kCellBytesRead}, count);
    const EntryList paths(record, {kCellsStart + kCellStride * count, kPathLength, kPathLength},
                          count);
    const std::int64_t receiveAgc = record.read(kReceiveAgc);
    Array active;
    const std::size_t whole = cells.wholeCount();
    for (std::size_t index = 0; index < whole; ++index) {
        if (cells.at(index).read(kSetType) != kActive) {
            continue;
        }
        if (!paths.isWhole(index)) {
            break; // the path record is part of the cell
        }
        const std::int64_t ecio_db = lookUpECNO(energyOf(paths.at(index)));
        Dictionary cell = entryOf(kCellFields, cells.at(index));
        cell.setFixed("RSCP", DisplayNumber(rscp_db(receiveAgc, ecio_db), kDecimalDb));
        cell.setFixed("Energy Per Chip", DisplayNumber(ecio_db, kDecimalDb));
        active.emplace_back(std::move(cell));
    }
    return active;
}

RecordDescription ActiveSet::describe() const {
    std::vector<Extent> energies;
    energies.reserve(kEnergyOffsets.size());
    for (const std::size_t offset : kEnergyOffsets) {
        energies.push_back(extentOf(u32At(offset), Extent::Origin::Companion));
    }
    std::vector<Extent> energiesAndAgc = energies;
    energiesAndAgc.push_back(extentOf(kReceiveAgc, Extent::Origin::Record));

    const EntryList::Layout cells{kCellsStart, kCellStride, kCellBytesRead};
    ListDescription list = describeList("", cells, u8At(kCellCountOffset), kCellFields);
    list.only = Condition{kSetType, kActive, kActive};
    list.companion = EntryRun{{kCellsStart, kPathLength, kPathLength},
                              EntryRun::Move{kCellStride, u8At(kCellCountOffset)}};
    list.fields.push_back(describeComputed(
        "RSCP", kDecimalDb, "rscp",
        "(A + 512) / 10 toward zero - 106 + Energy Per Chip, A being the receive AGC, signed",
        std::move(energiesAndAgc)));
    list.fields.push_back(describeComputed(
        "Energy Per Chip", kDecimalDb, "ecno",
        "whole dB of the first of the three energies of the cell's path that is not 0",
        std::move(energies)));

    RecordDescription description = SearcherSet::describe();
    description.front().lists = {std::move(list)};
    description.front().note = "Only the cells of the active set are shown.";
    return description;
}

} // namespace pallax
