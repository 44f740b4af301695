#include "LogGenerator/LTE/LTEServingCellInfo.h"

#include "LogGenerator/Common/CellMonitor.h"
#include "platform/TelephonyConstants.h"

#include <array>

namespace pallax {

namespace {

/// Indexed by the number of resource blocks.
constexpr auto kBandwidths = [] {
    std::array<std::string_view, 101> labels{};
    labels.fill("Unknown");
    labels[6] = "1.4 MHz";
    labels[15] = "3 MHz";
    labels[25] = "5 MHz";
    labels[50] = "10 MHz";
    labels[75] = "15 MHz";
    labels[100] = "20 MHz";
    return labels;
}();

constexpr std::string_view kPhysicalCellIdKey = "Physical Cell ID";
constexpr std::string_view kCellIdentityKey = "Cell Identity";
constexpr std::string_view kTrackingAreaKey = "Tracking Area Code";
constexpr std::string_view kBandKey = "Freq Band Indicator";
constexpr std::string_view kUarfcnKey = "UARFCN";

constexpr auto kIdentityFields = std::to_array<Field>({
    {kPhysicalCellIdKey, u16At(14), Conversion::number(),
     "Physical cell identity of the serving cell, 0 to 503."},
    {"Download Frequency", u16At(16), Conversion::number(), "EARFCN of the downlink carrier."},
    {"Upload Frequency", u16At(18), Conversion::number(), "EARFCN of the uplink carrier."},
    {"Download Bandwidth", u8At(20), Conversion::label(kBandwidths),
     "Channel bandwidth of the downlink, reported in resource blocks."},
    {"Upload Bandwidth", u8At(21), Conversion::label(kBandwidths),
     "Channel bandwidth of the uplink, reported in resource blocks."},
    {kCellIdentityKey, s32At(22), Conversion::number(),
     "E-UTRAN cell identity, 28 bits: the eNodeB and the cell in it."},
    {kTrackingAreaKey, u16At(26), Conversion::number(),
     "Code of the tracking area that the cell belongs to."},
    {kBandKey, s32At(28), Conversion::number(), "Number of the E-UTRA operating band."},
});

/// The cell monitor's value for the previous cell.
constexpr auto kForeignKeys = std::to_array<std::string_view>({kUarfcnKey});

constexpr auto kAntennasFields = std::to_array<Field>({
    {"Num Tx Antennas", u8At(20), Conversion::number(),
     "Number of transmit antenna ports of the cell."},
});

constexpr auto kCellFields = std::to_array<Field>({
    cellNumber(kTrackingAreaKey, kHXCellMonitorTAC, "Serving Cell Info: Failed to retrieve TAC\n"),
    cellNumber(kCellIdentityKey, kHXCellMonitorCellId,
               "Serving Cell Info: Failed to retrieve Cell ID\n"),
    cellNumber(kPhysicalCellIdKey, kHXCellMonitorPID,
               "Serving Cell Info: Failed to retrieve Physical Cell ID\n"),
    cellNumber(kBandKey, kHXCellMonitorBandInfo,
               "Serving Cell Info: Failed to retrieve Freq Band Indicator\n"),
    cellNumber(kUarfcnKey, kHXCellMonitorUARFCN, "Serving Cell Info: Failed to retrieve UARFCN\n",
               "Channel number that the telephony service gives for the serving cell."),
});
constexpr auto kTechnologies =
    std::to_array<std::string_view>({kHXCellMonitorRadioAccessTechnologyLTE});
constexpr ListPart kServingCell{
    .kind = ListPart::Kind::FirstCell,
    .parse = parseCellMonitorArray,
    .technologies = kTechnologies,
    .cellType = kHXCellMonitorCellTypeServing,
};

/// Log readers expect this line after every antenna report.
void logAntennas(const CodeLayout& code, const LogRecord& /*record*/) {
    logUnknownLogCode(code.logCode);
}

constexpr auto kCodes = std::to_array<CodeLayout>({
    {
        .logCode = 0xB0C2,
        .name = "Identity of the serving cell",
        .minimumLength = 38,
        .fields = kIdentityFields,
        .removes = kForeignKeys,
        .note = "Removes \"UARFCN\", which is of the cell before.",
    },
    {
        .logCode = 0xB0C1,
        .name = "Antennas of the serving cell",
        .minimumLength = 22,
        .fields = kAntennasFields,
        .logs = logAntennas,
    },
    {
        .logCode = kCellMonitorLogCode,
        .name = kCellMonitorName,
        .fields = kCellFields,
        .listPart = &kServingCell,
    },
});

constexpr RecordLayout kLayout{
    .section = "Serving Cell Info",
    .logLine = "LTE Serving Cell Info",
    .meaning = "Identity, carrier and antennas of the serving cell.",
    .codes = kCodes,
};

} // namespace

LTEServingCellInfo::LTEServingCellInfo() : LayoutRecord(kLayout) {}

} // namespace pallax
