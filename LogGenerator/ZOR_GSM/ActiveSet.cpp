#include "LogGenerator/ZOR_GSM/ActiveSet.h"

#include "LogGenerator/ZOR_GSM/SearcherRecord.h"

#include <algorithm>
#include <array>

namespace pallax {

namespace {

constexpr Position kReceiveAgc = s16At(13);
constexpr Position kCellCount = u8At(15);

constexpr std::size_t kCellStride = 15;
constexpr std::size_t kPathLength = 44;
constexpr Condition kIsActive{bitsAt(8, 5, 3), 0, 0};

/// The energies of a path record.
constexpr auto kEnergies = std::to_array<Extent>({
    extentOf(u32At(32), Extent::Origin::Companion),
    extentOf(u32At(36), Extent::Origin::Companion),
    extentOf(u32At(40), Extent::Origin::Companion),
});
constexpr auto kEnergiesAndAgc = std::to_array<Extent>({
    kEnergies[0],
    kEnergies[1],
    kEnergies[2],
    extentOf(kReceiveAgc, Extent::Origin::Record),
});

/// Ec/Io of the path record's first energy that is not 0, or of 0 if all are 0.
std::int64_t ecio_db(const LogRecord& path) {
    const auto* const energy =
        std::find_if(kEnergies.begin(), kEnergies.end(),
                     [&path](const Extent& candidate) { return path.u32(candidate.byte) != 0; });
    return Base::lookUpECNO(energy != kEnergies.end() ? path.u32(energy->byte) : 0);
}

PropertyList energyPerChip(const Place& place) {
    return DisplayNumber(ecio_db(place.companion), kDecimalDb);
}

PropertyList rscp(const Place& place) {
    constexpr std::int64_t kAgcOffset = 512;
    constexpr std::int64_t kAgcStepsPerDb = 10;
    constexpr std::int64_t kFloorDbm = 106;
    const std::int64_t receiveAgc = place.record.read(kReceiveAgc);
    return DisplayNumber((receiveAgc + kAgcOffset) / kAgcStepsPerDb - kFloorDbm +
                             ecio_db(place.companion),
                         kDecimalDb);
}

constexpr Computation kRscp{
    .name = "rscp",
    .formula = "(A + 512) / 10 toward zero - 106 + Energy Per Chip, A being the receive AGC, "
               "signed",
    .read = kEnergiesAndAgc,
    .compute = rscp,
};
constexpr Computation kEnergyPerChip{
    .name = "ecno",
    .formula = "whole dB of the first of the three energies of the cell's path that is not 0",
    .read = kEnergies,
    .compute = energyPerChip,
};

constexpr auto kCellFields = std::to_array<Field>({
    Field{"Scrambling Code", bitsAt(7, 0, 13), Conversion::number(),
          "Primary scrambling code of the cell."}
        .identifying(),
    computed(
        "RSCP", kDecimalDb, kRscp,
        "Received signal code power of the cell's pilot, computed from receiver gain and Ec/Io."),
    computed("Energy Per Chip", kDecimalDb, kEnergyPerChip,
             "Ec/Io of the cell's pilot: energy per chip over the whole received power."),
});

constexpr auto kLists = std::to_array<ListLayout>({{
    .entries = {{.start = kSearcherRecordLength, .stride = kCellStride, .bytesRead = 9}},
    .count = kCellCount,
    .fields = kCellFields,
    .only = &kIsActive,
    .companion = EntryRun{{kSearcherRecordLength, kPathLength, kPathLength},
                          EntryRun::Move{kCellStride, kCellCount}},
}});

constexpr auto kCodes = std::to_array<CodeLayout>({{
    .logCode = kSearcherLogCode,
    .name = "Cells of the UMTS searcher",
    .minimumLength = kSearcherRecordLength,
    .lists = kLists,
    .note = "Only the cells of the active set are shown.",
}});

constexpr RecordLayout kLayout{
    .section = "Active Set",
    .logLine = "ActiveSet",
    .kind = SectionKind::List,
    .meaning = "The UMTS cells that the phone is connected through.",
    .codes = kCodes,
};

} // namespace

ActiveSet::ActiveSet() : LayoutRecord(kLayout) {}

} // namespace pallax
