#include "LogGenerator/ZOR_GSM/UMTSSet.h"

#include "LogGenerator/Common/CellMonitor.h"
#include "LogGenerator/ZOR_GSM/RankingRecord.h"
#include "platform/TelephonyConstants.h"

#include <array>

namespace pallax {

namespace {

constexpr std::size_t kEntryLength = 10;

constexpr NumberFormat kRealDb{"%f dB"};
constexpr double kRscpOffsetDb = -21.0;
constexpr double kEnergyStepDb = 0.5;

constexpr std::string_view kScramblingCodeKey = "Scrambling Code";
constexpr std::string_view kRscpKey = "RSCP";
constexpr std::string_view kEnergyKey = "Energy Per Chip";

constexpr auto kEntryFields = std::to_array<Field>({
    Field{kScramblingCodeKey, u16At(2), Conversion::number(),
          "Primary scrambling code of the cell."}
        .identifying(),
    {kRscpKey, s8At(4), Conversion::number(kDecimalDb, 1.0, kRscpOffsetDb),
     "Received signal code power of the cell's pilot."},
    {kEnergyKey, s8At(7), Conversion::number(kRealDb, kEnergyStepDb),
     "Ec/No of the cell's pilot: energy per chip over noise."},
    Field{"Downlink Frequency", s16At(0), Conversion::number(),
          "UARFCN of the cell's downlink carrier."}
        .identifying(),
    {"Ranking Value", s16At(8), Conversion::number(), "Rank of the cell in reselection."},
    {"Rank Cell RSCP", s16At(5), Conversion::number(kDecimalDb),
     "Received signal code power by which the cell is ranked."},
});

constexpr auto kLists = std::to_array<ListLayout>({{
    .entries = {{kRankingEntriesStart, kEntryLength, kEntryLength}},
    .count = u8At(13),
    .fields = kEntryFields,
}});

constexpr auto kCellFields = std::to_array<Field>({
    cellNumber("UARFCN", kHXCellMonitorUARFCN, "UMTSSet: Failed to retrieve UARFCN\n",
               "UARFCN of the cell.")
        .identifying(),
    cellNumber(kScramblingCodeKey, kHXCellMonitorSCN,
               "UMTSSet: Failed to retrieve Scrambling Code\n")
        .identifying(),
    cellLevel(kRscpKey, kHXCellMonitorRSCP, "UMTSSet: Failed to retrieve RSCP\n", kDecimalDbm),
    cellLevel(kEnergyKey, kHXCellMonitorECN0, "UMTSSet: Failed to retrieve Energy Per Chip\n",
              kDecimalDb),
});
constexpr auto kTechnologies =
    std::to_array<std::string_view>({kHXCellMonitorRadioAccessTechnologyUMTS});
constexpr ListPart kNeighbourCells{
    .kind = ListPart::Kind::CellEntries,
    .parse = parseCellMonitorArray,
    .technologies = kTechnologies,
    .cellType = kHXCellMonitorCellTypeNeighbor,
};

constexpr auto kCodes = std::to_array<CodeLayout>({
    {
        .logCode = kRankingLogCode,
        .name = "Ranking of UMTS and GSM cells",
        .minimumLength = kRankingRecordLength,
        .lists = kLists,
    },
    {
        .logCode = kCellMonitorLogCode,
        .fields = kCellFields,
        .listPart = &kNeighbourCells,
        .note = kLevelsNote,
    },
});

constexpr RecordLayout kLayout{
    .section = "UMTS Set",
    .logLine = "UMTSSet",
    .kind = SectionKind::List,
    .meaning = "The UMTS neighbours: ranked for reselection, or from the cell monitor, whichever "
               "came last.",
    .codes = kCodes,
};

} // namespace

UMTSSet::UMTSSet() : LayoutRecord(kLayout) {}

} // namespace pallax
