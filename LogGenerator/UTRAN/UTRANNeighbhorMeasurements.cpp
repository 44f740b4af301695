#include "LogGenerator/UTRAN/UTRANNeighbhorMeasurements.h"

#include "LogGenerator/Records/EntryList.h"
#include "platform/SystemLog.h"

#include <array>

namespace pallax {

namespace {

constexpr LogCode kNeighboursLogCode = 0xD00A;
constexpr auto kLogCodes = std::to_array<LogCode>({kNeighboursLogCode});
constexpr std::size_t kMinimumLength = 21;

constexpr Position kCellCount = bitsAt(16, 1, 7);
constexpr EntryList::Layout kCells{.start = 168, .stride = 16, .bytesRead = 4};

constexpr NumberFormat kSixDecimals{"%f"};
constexpr double kRscpStep = 1.0 / 256;

constexpr auto kFields = std::to_array<Field>({
    {"UARFCN", bitsAt(0, 0, 14), Conversion::number()},
    {"Cell ID", bitsAt(1, 6, 7), Conversion::number()},
    {"Filter RSCP", bitsAt(2, 5, 8), Conversion::number(kSixDecimals, kRscpStep)},
});

constexpr Position kStatus = bitsAt(3, 5, 2);
constexpr auto kStatuses = std::to_array<std::string_view>({"ASET", "MSET", "DSET"});
static_assert(kStatuses.size() == 3);
constexpr auto kStatusField =
    std::to_array<Field>({{"Status", kStatus, Conversion::label(kStatuses)}});

constexpr auto kDetectionField =
    std::to_array<Field>({{"inJDCS", bitsAt(3, 7, 1), Conversion::flag("TRUE", "FALSE")}});

PropertyList cellOf(const LogRecord& entry) {
    Dictionary cell;
    cell.reserve(kFields.size() + kStatusField.size() + kDetectionField.size());
    showFields(cell, kFields, entry);
    if (entry.read(kStatus) < std::int64_t{kStatuses.size()}) {
        showFields(cell, kStatusField, entry);
    }
    showFields(cell, kDetectionField, entry);
    return cell;
}

} // namespace

std::span<const LogCode> UTRANNeighbhorMeasurements::getLogCodeArray() const {
    return kLogCodes;
}

void UTRANNeighbhorMeasurements::updateWithData(const LogRecord& record, LogCode logCode) {
    systemLog(LogPriority::Warning, "NeighbhorMeasurements List");
    if (logCode != kNeighboursLogCode || !record.has(kMinimumLength)) {
        return;
    }
    clearList();
    const EntryList cells(record, kCells, static_cast<std::size_t>(record.read(kCellCount)));
    replaceList(cells.map([](const LogRecord& entry, std::size_t) { return cellOf(entry); }));
}

} // namespace pallax
