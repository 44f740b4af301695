#include "LogGenerator/ZOR_GSM/GSMSet.h"

#include "LogGenerator/ZOR_GSM/RankingRecord.h"

#include <array>

namespace pallax {

namespace {

constexpr std::size_t kEntryLength = 7;

constexpr auto kEntryFields = std::to_array<Field>({
    Field{"ARFCN", u16At(0), Conversion::number(), "ARFCN of the cell's BCCH carrier."}
        .identifying(),
    Field{"BSIC", u16At(2), Conversion::number(), "Base station identity code."}.identifying(),
    {"RSSI", s8At(4), Conversion::number(kDecimalDbm), "Receive level of the cell."},
    {"Ranking Value", s16At(5), Conversion::number(), "Rank of the cell in reselection."},
});

constexpr auto kLists = std::to_array<ListLayout>({{
    .entries = {{kRankingEntriesStart, kEntryLength, kEntryLength}},
    .count = u8At(14),
    .fields = kEntryFields,
}});

constexpr auto kCodes = std::to_array<CodeLayout>({{
    .logCode = kRankingLogCode,
    .minimumLength = kRankingRecordLength,
    .lists = kLists,
}});

constexpr RecordLayout kLayout{
    .section = "GSM Set",
    .logLine = "GSMSet",
    .kind = SectionKind::List,
    .meaning = "The GSM cells that are ranked for reselection.",
    .codes = kCodes,
};

} // namespace

GSMSet::GSMSet() : LayoutRecord(kLayout) {}

} // namespace pallax
