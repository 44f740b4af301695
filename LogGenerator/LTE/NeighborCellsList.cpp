#include "LogGenerator/LTE/NeighborCellsList.h"

#include "LogGenerator/LTE/SharedLTERecords.h"
#include "LogGenerator/Records/Description.h"
#include "LogGenerator/Records/EntryList.h"
#include "platform/SystemLog.h"

#include <array>

namespace pallax {

namespace {

constexpr auto kLogCodes = std::to_array<LogCode>({kNeighborMeasurementLogCode});

constexpr Position kCountLessOne = bitsAt(19, 6, 5);
constexpr EntryList::Layout kCells{
    .start = kNeighborMeasurementLength, .stride = 20, .bytesRead = 16};

constexpr Conversion kPower = Conversion::number(kLevelDbm, 0.5, -140.0);
constexpr Conversion kRsrq = Conversion::number(kLevelDb, 0.25, -30.0);
constexpr Position kPhysicalCellId = bitsAt(0, 0, 9);
constexpr Position kFrameOffset = bitsAt(12, 0, 11);
constexpr Position kSampleOffset = bitsAt(13, 3, 19);

constexpr auto kCellFields = std::to_array<Field>({
    {"Physical Cell ID", kPhysicalCellId, Conversion::number()},
    {"Measured RSSI", bitsAt(1, 1, 8), kPower},
    {"Measured RSRP", bitsAt(2, 1, 9), kPower},
    {"Average RSRP", bitsAt(4, 0, 9), kPower},
    {"Measured RSRQ", bitsAt(5, 1, 7), kRsrq},
    {"Average RSRQ", bitsAt(6, 0, 7), kRsrq},
    {"Srxlev", bitsAt(6, 7, 7), Conversion::number(kDecimalDbm, 1.0, -30.0)},
    {"Frequency Offset", u16At(8), Conversion::number()},
    {"Ant 0 Frame Offset", kFrameOffset, Conversion::number()},
    {"Ant 0 Sample Offset", kSampleOffset, Conversion::number()},
    {"Ant 1 Frame Offset", kFrameOffset, Conversion::number()},
    {"Ant 1 Sample Offset", kSampleOffset, Conversion::number()},
});
static_assert(kCellFields.size() == 12);

/// One line for the cell, and one for each of its levels: the values that are no whole numbers.
void trace(const Dictionary& cell, std::int64_t physicalCellId) {
    if (!SystemLog::isEnabled(LogPriority::Warning)) {
        return;
    }
    systemLog(LogPriority::Warning, "Physical Cell ID: %d\n", physicalCellId);
    for (const Dictionary::Entry& entry : cell) {
        const DisplayNumber* number = entry.value.displayNumber();
        if (number != nullptr && number->isReal()) {
            systemLog(LogPriority::Warning, "Measured RSSI: %lf\n", number->real());
        }
    }
}

void fillCell(Dictionary& cell, const LogRecord& entry) {
    fillEntry(cell, kCellFields, entry);
    trace(cell, entry.read(kPhysicalCellId));
}

} // namespace

std::span<const LogCode> NeighborCellsList::getLogCodeArray() const {
    return kLogCodes;
}

void NeighborCellsList::updateWithData(const LogRecord& record, LogCode logCode) {
    systemLog(LogPriority::Warning, "Neighbor Cells List");
    if (logCode != kNeighborMeasurementLogCode) {
        return logUnknown(logCode);
    }
    if (!record.has(kNeighborMeasurementLength)) {
        return;
    }
    clearList();
    const auto count = static_cast<std::size_t>(record.read(kCountLessOne)) + 1;
    systemLog(LogPriority::Warning, "Number of neighboring cells being reported: %d\n", count);
    const EntryList cells(record, kCells, count);
    replaceList(cells, fillCell);
}

bool NeighborCellsList::replacesShown(const LogRecord& record, LogCode logCode) const {
    return logCode == kNeighborMeasurementLogCode && record.has(kNeighborMeasurementLength);
}

RecordDescription NeighborCellsList::describe() const {
    ListDescription list = describeList("", kCells, kCountLessOne, kCellFields);
    list.plus = 1;
    CodeDescription code{kNeighborMeasurementLogCode, kNeighborMeasurementLength};
    code.lists = {std::move(list)};
    return {std::move(code)};
}

} // namespace pallax
