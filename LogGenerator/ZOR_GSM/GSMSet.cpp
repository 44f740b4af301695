#include "LogGenerator/ZOR_GSM/GSMSet.h"

#include "LogGenerator/Records/Description.h"
#include "LogGenerator/Records/EntryList.h"
#include "LogGenerator/ZOR_GSM/RankingRecord.h"
#include "platform/SystemLog.h"

#include <array>

namespace pallax {

namespace {

constexpr auto kLogCodes = std::to_array<LogCode>({kRankingLogCode});

constexpr std::size_t kCountOffset = 14;
constexpr std::size_t kEntryLength = 7;

constexpr auto kEntryFields = std::to_array<Field>({
    {"ARFCN", u16At(0), Conversion::number()},
    {"BSIC", u16At(2), Conversion::number()},
    {"RSSI", s8At(4), Conversion::number(kDecimalDbm)},
    {"Ranking Value", s16At(5), Conversion::number()},
});

} // namespace

std::span<const LogCode> GSMSet::getLogCodeArray() const {
    return kLogCodes;
}

void GSMSet::updateWithData(const LogRecord& record, LogCode logCode) {
    systemLog(LogPriority::Warning, "GSMSet");
    if (logCode != kRankingLogCode) {
        return logUnknown(logCode);
    }
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

bool GSMSet::replacesShown(const LogRecord& record, LogCode logCode) const {
    return logCode == kRankingLogCode && record.has(kRankingRecordLength);
}

RecordDescription GSMSet::describe() const {
    CodeDescription code{kRankingLogCode, kRankingRecordLength};
    code.lists = {describeList("", {kRankingEntriesStart, kEntryLength, kEntryLength},
                               u8At(kCountOffset), kEntryFields)};
    return {std::move(code)};
}

} // namespace pallax
