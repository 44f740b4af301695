#include "LogGenerator/ZOR_GSM/GSMServingCell.h"

#include "LogGenerator/Common/CellMonitor.h"
#include "LogGenerator/ZOR_GSM/SharedLogCodes.h"
#include "platform/TelephonyConstants.h"

#include <array>

namespace pallax {

namespace {

constexpr std::string_view kCellIdKey = "Cell ID";
constexpr std::string_view kARFCNKey = "ARFCN";

constexpr auto kIdentityFields = std::to_array<Field>({
    {kCellIdKey, u16At(17), Conversion::number(), "Identity of the cell in its location area."},
    {kARFCNKey, u16At(13), Conversion::number(), "ARFCN of the cell's BCCH carrier."},
    {"BSIC", u16At(15), Conversion::number(), "Base station identity code."},
});

constexpr auto kMeasurementFields = std::to_array<Field>({
    {"RSSI", u8At(15), Conversion::number(kDecimalDbm),
     "Receive level of the serving cell: the byte as it is, so a positive number."},
    {"C1 Value", u16At(16), Conversion::number(),
     "Path loss criterion C1 of cell selection; negative values show as large numbers."},
    {"C2 Value", u16At(20), Conversion::number(),
     "Reselection criterion C2; negative values show as large numbers."},
});

constexpr auto kDedicatedChannelFields = std::to_array<Field>({
    {"MA Dedicated ARFCN", u8At(13), Conversion::number(),
     "ARFCN of the dedicated channel, of which the low 8 bits are shown."},
});

constexpr auto kCellFields = std::to_array<Field>({
    cellNumber(kCellIdKey, kHXCellMonitorCellId, "GSMServingCell: Failed to retrieve Cell ID\n"),
    cellNumber(kARFCNKey, kHXCellMonitorARFCN, "GSMServingCell: Failed to retrieve ARFCN\n"),
});
constexpr auto kTechnologies =
    std::to_array<std::string_view>({kHXCellMonitorRadioAccessTechnologyGSM});
constexpr ListPart kServingCell{
    .kind = ListPart::Kind::FirstCell,
    .parse = parseCellMonitorArray,
    .technologies = kTechnologies,
    .cellType = kHXCellMonitorCellTypeServing,
};

constexpr auto kCodes = std::to_array<CodeLayout>({
    {
        .logCode = 0x5134,
        .name = "Identity of the GSM serving cell",
        .minimumLength = 26,
        .fields = kIdentityFields,
    },
    {
        .logCode = kMeasurementLogCode,
        .name = "Measurement of the GSM serving cell and its neighbours",
        .minimumLength = kMeasurementLength,
        .fields = kMeasurementFields,
    },
    {
        .logCode = 0x5076,
        .name = "Dedicated channel of GSM",
        .minimumLength = 17,
        .fields = kDedicatedChannelFields,
    },
    {
        .logCode = kCellMonitorLogCode,
        .name = kCellMonitorName,
        .fields = kCellFields,
        .listPart = &kServingCell,
    },
});

constexpr RecordLayout kLayout{
    .section = "GSM Serving Cell",
    .logLine = "GSMServingCell",
    .meaning = "Identity and levels of the GSM serving cell.",
    .codes = kCodes,
};

} // namespace

GSMServingCell::GSMServingCell() : LayoutRecord(kLayout) {}

} // namespace pallax
