#include "LogGenerator/ZOR_GSM/UMTSSet.h"

#include "LogGenerator/Common/CellMonitor.h"
#include "LogGenerator/Records/Description.h"
#include "LogGenerator/Records/EntryList.h"
#include "LogGenerator/ZOR_GSM/RankingRecord.h"
#include "platform/SystemLog.h"
#include "platform/TelephonyConstants.h"

#include <array>

namespace pallax {

namespace {

constexpr auto kLogCodes = std::to_array<LogCode>({kRankingLogCode, kCellMonitorLogCode});

constexpr std::size_t kCountOffset = 13;
constexpr std::size_t kEntryLength = 10;

constexpr NumberFormat kRealDb{"%f dB"};
constexpr double kRscpOffsetDb = -21.0;
constexpr double kEnergyStepDb = 0.5;

constexpr std::string_view kScramblingCodeKey = "Scrambling Code";
constexpr std::string_view kRscpKey = "RSCP";
constexpr std::string_view kEnergyKey = "Energy Per Chip";

constexpr auto kEntryFields = std::to_array<Field>({
    {kScramblingCodeKey, u16At(2), Conversion::number()},
    {kRscpKey, s8At(4), Conversion::number(kDecimalDb, 1.0, kRscpOffsetDb)},
    {kEnergyKey, s8At(7), Conversion::number(kRealDb, kEnergyStepDb)},
    {"Downlink Frequency", s16At(0), Conversion::number()},
    {"Ranking Value", s16At(8), Conversion::number()},
    {"Rank Cell RSCP", s16At(5), Conversion::number(kDecimalDb)},
});

constexpr auto kCellNumbers = std::to_array<CellNumber>({
    {"UARFCN", kHXCellMonitorUARFCN, "UMTSSet: Failed to retrieve UARFCN\n"},
    {kScramblingCodeKey, kHXCellMonitorSCN, "UMTSSet: Failed to retrieve Scrambling Code\n"},
});
constexpr auto kCellLevels = std::to_array<CellLevel>({
    {kRscpKey, kHXCellMonitorRSCP, "UMTSSet: Failed to retrieve RSCP\n", &kDecimalDbm},
    {kEnergyKey, kHXCellMonitorECN0, "UMTSSet: Failed to retrieve Energy Per Chip\n", &kDecimalDb},
});

} // namespace

std::span<const LogCode> UMTSSet::getLogCodeArray() const {
    return kLogCodes;
}

void UMTSSet::updateWithData(const LogRecord& record, LogCode logCode) {
    systemLog(LogPriority::Warning, "UMTSSet");
    switch (logCode) {
    case kRankingLogCode:
        return updateFromRanking(record);
    case kCellMonitorLogCode:
        return updateFromCellMonitor(record);
    default:
        return logUnknown(logCode);
    }
}

bool UMTSSet::replacesShown(const LogRecord& record, LogCode logCode) const {
    return logCode == kRankingLogCode && record.has(kRankingRecordLength);
}

void UMTSSet::updateFromRanking(const LogRecord& record) {
    if (!record.has(kRankingRecordLength)) {
        return;
    }
    clearList();
    const EntryList entries(record, {kRankingEntriesStart, kEntryLength, kEntryLength},
                            record.u8(kCountOffset));
    if (entries.count() != 0) {
        replaceList(entries, [](Dictionary& target, const LogRecord& entry) {
            fillEntry(target, kEntryFields, entry);
        });
    }
}

void UMTSSet::updateFromCellMonitor(const LogRecord& record) {
    const std::optional<Array> cells = readCellMonitorArray(record);
    clearList(); // also when nothing could be read
    if (!cells) {
        return logNoCellArray();
    }
    replaceList(cellEntries(*cells, kHXCellMonitorRadioAccessTechnologyUMTS,
                            kHXCellMonitorCellTypeNeighbor, kCellNumbers, kCellLevels));
}

RecordDescription UMTSSet::describe() const {
    CodeDescription ranking{kRankingLogCode, kRankingRecordLength};
    ranking.lists = {describeList("", {kRankingEntriesStart, kEntryLength, kEntryLength},
                                  u8At(kCountOffset), kEntryFields)};
    CodeDescription monitored = describeCells(ListPartDescription{ListPartDescription::Kind::CellEntries,
                                                       {kHXCellMonitorRadioAccessTechnologyUMTS},
                                                       kHXCellMonitorCellTypeNeighbor},
                                              kCellNumbers, kCellLevels);
    return {std::move(ranking), std::move(monitored)};
}

} // namespace pallax
