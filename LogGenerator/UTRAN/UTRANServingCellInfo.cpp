#include "LogGenerator/UTRAN/UTRANServingCellInfo.h"

#include "LogGenerator/Common/CellMonitor.h"
#include "platform/TelephonyConstants.h"

#include <array>

namespace pallax {

namespace {

constexpr std::string_view kCellIdKey = "Cell ID";
constexpr std::string_view kDownlinkKey = "Downlink UARFCN";
constexpr std::string_view kUplinkKey = "Uplink UARFCN";

constexpr auto kFields = std::to_array<Field>({
    {"Cell Access Restrictions", u8At(14), Conversion::number(),
     "Access restrictions of the cell, as one number; the meaning of the values is not known."},
    {kCellIdKey, s32At(21), Conversion::number(), "Identity of the serving cell."},
    {kDownlinkKey, u16At(19), Conversion::number(), "UARFCN of the downlink carrier."},
    {kUplinkKey, u16At(17), Conversion::number(), "UARFCN of the uplink carrier."},
    {"URA ID", u8At(15), Conversion::number(), "Identity of the UTRAN registration area."},
    {"Allowed Access", bitsAt(25, 0, 1), Conversion::flag("Emergency Calls Only", "All Calls"),
     "Whether the cell accepts all calls or emergency calls only."},
});

constexpr auto kCellFields = std::to_array<Field>({
    cellNumber("Local Area Code", kHXCellMonitorLAC, "Serving Cell Info: Failed to retrieve LAC\n",
               "Code of the location area that the cell belongs to."),
    cellNumber(kCellIdKey, kHXCellMonitorCellId, "Serving Cell Info: Failed to retrieve Cell ID\n"),
    cellNumber("Freq Band Indicator", kHXCellMonitorBandInfo,
               "Serving Cell Info: Failed to retrieve Freq Band Indicator\n",
               "Number of the operating band."),
    cellNumber("Cell Scrambling Code", kHXCellMonitorSCN,
               "Serving Cell Info: Failed to retrieve Cell Scrambling Code\n",
               "Scrambling code of the serving cell."),
    // The service sends one frequency without its link. If it is missing, this is logged once.
    cellNumber(kUplinkKey, kHXCellMonitorUARFCN, "Serving Cell Info: Failed to retrieve UARFCN\n"),
    cellNumber(kDownlinkKey, kHXCellMonitorUARFCN, ""),
});
constexpr auto kTechnologies =
    std::to_array<std::string_view>({kHXCellMonitorRadioAccessTechnologyUTRAN2});
constexpr ListPart kServingCells{
    .kind = ListPart::Kind::EachCell,
    .parse = parseCellMonitorArrayQuietly,
    .technologies = kTechnologies,
    .cellType = kHXCellMonitorCellTypeServing,
};

constexpr auto kCodes = std::to_array<CodeLayout>({
    {
        .logCode = 0xD0E2,
        .name = "Serving cell",
        .minimumLength = 26,
        .fields = kFields,
    },
    {
        .logCode = kCellMonitorLogCode,
        .name = kCellMonitorName,
        .fields = kCellFields,
        .listPart = &kServingCells,
    },
});

constexpr RecordLayout kLayout{
    .section = "Serving Cell Info",
    .logLine = "Serving Cell Info",
    .meaning = "Identity, carrier and access rules of the serving cell.",
    .codes = kCodes,
    .reportsOtherCodes = false,
};

} // namespace

UTRANServingCellInfo::UTRANServingCellInfo() : LayoutRecord(kLayout) {}

} // namespace pallax
