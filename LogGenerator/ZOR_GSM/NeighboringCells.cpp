#include "LogGenerator/ZOR_GSM/NeighboringCells.h"

#include "LogGenerator/Common/CellMonitor.h"
#include "LogGenerator/Records/Description.h"
#include "LogGenerator/Records/EntryList.h"
#include "LogGenerator/ZOR_GSM/SharedLogCodes.h"
#include "platform/SystemLog.h"
#include "platform/TelephonyConstants.h"

namespace pallax {

namespace {

constexpr LogCode kBsicListLogCode = 0x51FF;
constexpr auto kLogCodes =
    std::to_array<LogCode>({kMeasurementLogCode, kBsicListLogCode, kCellMonitorLogCode});

constexpr std::size_t kNeighbourCountOffset = 28;
constexpr EntryList::Layout kNeighbours{.start = 29, .stride = 14, .bytesRead = 7};

constexpr std::size_t kBsicListMinimumLength = 15;
constexpr std::size_t kBsicCountOffset = 14;
constexpr EntryList::Layout kBsics{.start = 15, .stride = 4, .bytesRead = 3};
constexpr std::size_t kArfcnInEntry = 0;
constexpr std::size_t kBsicInEntry = 2;

constexpr std::string_view kARFCNKey = "ARFCN";
constexpr std::string_view kRSSIKey = "RSSI";
constexpr std::string_view kBSICKey = "BSIC";

constexpr auto kNeighbourFields = std::to_array<Field>({
    {kARFCNKey, u16At(kArfcnInEntry), Conversion::number()},
    {kRSSIKey, u8At(2), Conversion::number()},
    {"C1 Value", s32At(3), Conversion::number()},
});

constexpr auto kCellNumbers = std::to_array<CellNumber>({
    {kARFCNKey, kHXCellMonitorARFCN, "NeighboringCells: Failed to retrieve ARFCN\n"},
});

/// The cell monitor counts levels in steps of this many dBm.
constexpr int kRssiStepDbm = 2;
constexpr auto kCellLevels = std::to_array<CellLevel>({
    {kRSSIKey, kHXCellMonitorRSSI, "NeighboringCells: Failed to retrieve RSSI\n", &kDecimalDbm,
     kRssiStepDbm},
});

} // namespace

std::span<const LogCode> NeighboringCells::getLogCodeArray() const {
    return kLogCodes;
}

void NeighboringCells::updateWithData(const LogRecord& record, LogCode logCode) {
    systemLog(LogPriority::Warning, "NeighboringCells");
    switch (logCode) {
    case kMeasurementLogCode:
        showMeasuredCells(record);
        break;
    case kBsicListLogCode:
        rememberBsics(record);
        break;
    case kCellMonitorLogCode:
        showMonitoredCells(record);
        break;
    default:
        logUnknown(logCode);
        break;
    }
}

bool NeighboringCells::replacesShown(const LogRecord& record, LogCode logCode) const {
    return logCode == kMeasurementLogCode && record.has(kMeasurementLength);
}

void NeighboringCells::showMeasuredCells(const LogRecord& record) {
    if (!record.has(kMeasurementLength)) {
        return;
    }
    clearList();
    const EntryList neighbours(record, kNeighbours, record.u8(kNeighbourCountOffset));
    if (neighbours.count() != 0) {
        replaceList(neighbours, [this](Dictionary& cell, const LogRecord& entry) {
            fillMeasuredCell(cell, entry);
        });
    }
}

void NeighboringCells::fillMeasuredCell(Dictionary& cell, const LogRecord& entry) const {
    fillEntry(cell, kNeighbourFields, entry);
    const auto bsic = arfcnToBsic.find(entry.u16(kArfcnInEntry));
    if (bsic != arfcnToBsic.end()) {
        cell.setFixed(kBSICKey, DisplayNumber(std::int64_t{bsic->second}, kDecimal));
    }
}

void NeighboringCells::rememberBsics(const LogRecord& record) {
    if (!record.has(kBsicListMinimumLength)) {
        return;
    }
    arfcnToBsic.clear(); // also when the new list is empty
    const EntryList bsics(record, kBsics, record.u8(kBsicCountOffset));
    const std::size_t whole = bsics.wholeCount();
    for (std::size_t index = 0; index < whole; ++index) {
        const LogRecord entry = bsics.at(index);
        arfcnToBsic.insert_or_assign(entry.u16(kArfcnInEntry), entry.u8(kBsicInEntry));
    }
}

void NeighboringCells::showMonitoredCells(const LogRecord& record) {
    clearList(); // what cannot be read leaves the list empty
    if (const std::optional<Array> cells = cellMonitorArrayOrLog(record)) {
        replaceList(cellEntries(*cells, kHXCellMonitorRadioAccessTechnologyGSM,
                                kHXCellMonitorCellTypeNeighbor, kCellNumbers, kCellLevels));
    }
}

RecordDescription NeighboringCells::describe() const {
    ListDescription neighbours =
        describeList("", kNeighbours, u8At(kNeighbourCountOffset), kNeighbourFields);
    neighbours.fields.push_back(
        describeComputed(kBSICKey, kDecimal, "bsic",
                         "what the last record 0x51FF told for the ARFCN; no key if nothing",
                         {extentOf(u16At(kArfcnInEntry))}));
    CodeDescription measured{kMeasurementLogCode, kMeasurementLength};
    measured.lists = {std::move(neighbours)};

    const auto told = std::to_array<Field>({
        {kARFCNKey, u16At(kArfcnInEntry), Conversion::number()},
        {kBSICKey, u8At(kBsicInEntry), Conversion::number()},
    });
    CodeDescription bsics{kBsicListLogCode, kBsicListMinimumLength};
    bsics.lists = {describeList("", kBsics, u8At(kBsicCountOffset), told)};
    bsics.lists.front().isShown = false;
    bsics.lists.front().rememberedAs = "bsic";
    bsics.note = "Remembered for the lists to come; shows nothing itself.";

    CodeDescription monitored = describeCells(ListPartDescription{ListPartDescription::Kind::CellEntries,
                                                       {kHXCellMonitorRadioAccessTechnologyGSM},
                                                       kHXCellMonitorCellTypeNeighbor},
                                              kCellNumbers, kCellLevels);
    return {std::move(measured), std::move(bsics), std::move(monitored)};
}

} // namespace pallax
