#include "LogGenerator/UTRAN/GSMNeighbhorMeasurements.h"

#include "LogGenerator/Records/Description.h"
#include "LogGenerator/Records/EntryList.h"
#include "platform/SystemLog.h"

#include <array>

namespace pallax {

namespace {

constexpr LogCode kNeighboursLogCode = 0xD00E;
constexpr auto kLogCodes = std::to_array<LogCode>({kNeighboursLogCode});
constexpr std::size_t kMinimumLength = 17;

constexpr std::size_t kCellCountOffset = 16;
constexpr EntryList::Layout kCells{.start = 17, .stride = 8, .bytesRead = 8};

constexpr auto kFields = std::to_array<Field>({
    {"Cell ID", bitsAt(0, 0, 14), Conversion::number()},
    {"Band Indicator", bitsAt(1, 6, 1), Conversion::number()},
    {"BSIC Valid", bitsAt(1, 7, 1), Conversion::number()},
    {"NCC", u8At(2), Conversion::number()},
    {"BCC", u8At(3), Conversion::number()},
    {"ARFCN", u16At(4), Conversion::number()},
    {"RSSI", s16At(6), Conversion::number()},
});

} // namespace

std::span<const LogCode> GSMNeighbhorMeasurements::getLogCodeArray() const {
    return kLogCodes;
}

Array GSMNeighbhorMeasurements::cellsOf(const LogRecord& record) {
    const EntryList cells(record, kCells, record.u8(kCellCountOffset));
    return cells.map(
        [](const LogRecord& entry, std::size_t /*index*/) { return entryOf(kFields, entry); });
}

void GSMNeighbhorMeasurements::updateWithData(const LogRecord& record, LogCode logCode) {
    systemLog(LogPriority::Warning, "GSM Neighbor Cell List");
    if (logCode != kNeighboursLogCode || !record.has(kMinimumLength)) {
        return;
    }
    clearList(); // the cells are for whoever asks for them, not for the display
}

RecordDescription GSMNeighbhorMeasurements::describe() const {
    CodeDescription code{kNeighboursLogCode, kMinimumLength};
    code.lists = {describeList("", kCells, u8At(kCellCountOffset), kFields)};
    code.lists.front().isShown = false;
    code.note = "Empties the list; the cells of the record are not shown.";
    return {std::move(code)};
}

} // namespace pallax
