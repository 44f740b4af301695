#include "LogGenerator/LTE/DetectedCells.h"

#include "LogGenerator/LTE/SharedLTERecords.h"
#include "LogGenerator/Records/Description.h"
#include "LogGenerator/Records/EntryList.h"
#include "platform/SystemLog.h"

#include <array>

namespace pallax {

namespace {

constexpr auto kLogCodes = std::to_array<LogCode>({kConnectedModeLogCode});

constexpr auto kCellFields = std::to_array<Field>({
    {"Physical Cell ID", u16At(0), Conversion::number()},
});

/// They stand behind the measured neighbours.
EntryList::Layout layoutOf(const LogRecord& record) {
    const std::size_t measured = record.u8(kMeasuredCountOffset);
    return {.start = kConnectedModeLength + measured * kMeasuredEntryLength,
            .stride = kDetectedEntryLength,
            .bytesRead = 2};
}

} // namespace

std::span<const LogCode> DetectedCells::getLogCodeArray() const {
    return kLogCodes;
}

void DetectedCells::updateWithData(const LogRecord& record, LogCode logCode) {
    systemLog(LogPriority::Warning, "Detected Cells");
    if (logCode != kConnectedModeLogCode) {
        return logUnknown(logCode);
    }
    if (!record.has(kConnectedModeLength)) {
        return;
    }
    clearList();
    const EntryList cells(record, layoutOf(record), record.u8(kDetectedCountOffset));
    if (cells.count() != 0) {
        replaceList(cells, [](Dictionary& target, const LogRecord& entry) {
            fillEntry(target, kCellFields, entry);
        });
    }
}

bool DetectedCells::replacesShown(const LogRecord& record, LogCode logCode) const {
    return logCode == kConnectedModeLogCode && record.has(kConnectedModeLength);
}

RecordDescription DetectedCells::describe() const {
    const EntryList::Layout behindNoNeighbours = layoutOf(LogRecord());
    ListDescription list =
        describeList("", behindNoNeighbours, u8At(kDetectedCountOffset), kCellFields);
    list.entries.move = EntryRun::Move{kMeasuredEntryLength, u8At(kMeasuredCountOffset)};
    CodeDescription code{kConnectedModeLogCode, kConnectedModeLength};
    code.lists = {std::move(list)};
    return {std::move(code)};
}

} // namespace pallax
