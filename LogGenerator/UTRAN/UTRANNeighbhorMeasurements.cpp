#include "LogGenerator/UTRAN/UTRANNeighbhorMeasurements.h"

#include "LogGenerator/Records/Description.h"
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

constexpr Position kStatus = bitsAt(3, 5, 2);
constexpr auto kStatuses = std::to_array<std::string_view>({"ASET", "MSET", "DSET"});
static_assert(kStatuses.size() == 3);

constexpr Field kUarfcn{"UARFCN", bitsAt(0, 0, 14), Conversion::number()};
constexpr Field kCellId{"Cell ID", bitsAt(1, 6, 7), Conversion::number()};
constexpr Field kFilterRscp{"Filter RSCP", bitsAt(2, 5, 8),
                            Conversion::number(kSixDecimals, kRscpStep)};
constexpr Field kStatusField{"Status", kStatus, Conversion::label(kStatuses)};
constexpr Field kDetection{"inJDCS", bitsAt(3, 7, 1), Conversion::flag("TRUE", "FALSE")};

constexpr auto kFields =
    std::to_array<Field>({kUarfcn, kCellId, kFilterRscp, kStatusField, kDetection});
/// Of a cell whose status is none of the three.
constexpr auto kFieldsWithoutStatus =
    std::to_array<Field>({kUarfcn, kCellId, kFilterRscp, kDetection});

void fillCell(Dictionary& cell, const LogRecord& entry) {
    if (entry.read(kStatus) < std::int64_t{kStatuses.size()}) {
        fillEntry(cell, kFields, entry);
    } else {
        fillEntry(cell, kFieldsWithoutStatus, entry);
    }
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
    replaceList(cells, fillCell);
}

bool UTRANNeighbhorMeasurements::replacesShown(const LogRecord& record, LogCode logCode) const {
    return logCode == kNeighboursLogCode && record.has(kMinimumLength);
}

RecordDescription UTRANNeighbhorMeasurements::describe() const {
    ListDescription list = describeList("", kCells, kCellCount, kFields);
    for (FieldDescription& field : list.fields) {
        if (field.key == kStatusField.key) {
            field.condition = Condition{kStatus, 0, std::int64_t{kStatuses.size()} - 1};
        }
    }
    CodeDescription code{kNeighboursLogCode, kMinimumLength};
    code.lists = {std::move(list)};
    return {std::move(code)};
}

} // namespace pallax
