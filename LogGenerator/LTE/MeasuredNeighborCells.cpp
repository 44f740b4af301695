#include "LogGenerator/LTE/MeasuredNeighborCells.h"

#include "LogGenerator/LTE/SharedLTERecords.h"
#include "LogGenerator/Records/Description.h"
#include "LogGenerator/Records/EntryList.h"
#include "platform/SystemLog.h"

#include <array>

namespace pallax {

namespace {

constexpr auto kLogCodes = std::to_array<LogCode>({kConnectedModeLogCode});

constexpr EntryList::Layout kNeighbours{
    .start = kConnectedModeLength, .stride = kMeasuredEntryLength, .bytesRead = 6};

constexpr auto kNeighbourFields = std::to_array<Field>({
    {"Physical Cell ID", u16At(0), Conversion::number()},
    {"Filtered RSRP", u16At(2), Conversion::number(kLevelDbm, 0.25, -140.0)},
    {"Filtered RSRQ", u16At(4), Conversion::number(kLevelDb, 0.125, -20.0)},
});

/// The bytes of the neighbours that the record claims, and those it has for them, as the modem
/// counts them: in 8 bits.
struct Sizes {
    std::uint8_t expected;
    std::uint8_t actual;
};

Sizes sizesOf(const LogRecord& record) {
    const std::size_t measured = kMeasuredEntryLength * record.u8(kMeasuredCountOffset);
    const std::size_t detected = kDetectedEntryLength * record.u8(kDetectedCountOffset);
    return {static_cast<std::uint8_t>(measured),
            static_cast<std::uint8_t>(record.length() - detected)};
}

/// Whether the record claims entries and seems to have room for them.
bool sizeIsExpected(const LogRecord& record) {
    const Sizes sizes = sizesOf(record);
    return record.u8(kMeasuredCountOffset) != 0 && sizes.expected <= sizes.actual;
}

} // namespace

std::span<const LogCode> MeasuredNeighborCells::getLogCodeArray() const {
    return kLogCodes;
}

void MeasuredNeighborCells::updateWithData(const LogRecord& record, LogCode logCode) {
    systemLog(LogPriority::Warning, "Measured Neighbor Cells");
    if (logCode != kConnectedModeLogCode) {
        return logUnknown(logCode);
    }
    if (!record.has(kConnectedModeLength)) {
        return;
    }
    clearList();
    if (!sizeIsExpected(record)) {
        const Sizes sizes = sizesOf(record);
        systemLog(LogPriority::Error, "Unexpected log packet bytes size: expected=%d actual=%d",
                  sizes.expected, sizes.actual);
        return;
    }
    const EntryList neighbours(record, kNeighbours, record.u8(kMeasuredCountOffset));
    replaceList(neighbours, [](Dictionary& target, const LogRecord& entry) {
        fillEntry(target, kNeighbourFields, entry);
    });
}

bool MeasuredNeighborCells::replacesShown(const LogRecord& record, LogCode logCode) const {
    return logCode == kConnectedModeLogCode && record.has(kConnectedModeLength) &&
           sizeIsExpected(record);
}

RecordDescription MeasuredNeighborCells::describe() const {
    ListDescription list =
        describeList("", kNeighbours, u8At(kMeasuredCountOffset), kNeighbourFields);
    list.sizeCheck = SizeCheck{u8At(kDetectedCountOffset), kDetectedEntryLength};
    CodeDescription code{kConnectedModeLogCode, kConnectedModeLength};
    code.lists = {std::move(list)};
    return {std::move(code)};
}

} // namespace pallax
