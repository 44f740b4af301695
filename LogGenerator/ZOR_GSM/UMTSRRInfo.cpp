#include "LogGenerator/ZOR_GSM/UMTSRRInfo.h"

#include "LogGenerator/Common/CellMonitor.h"
#include "platform/TelephonyConstants.h"

#include <array>
#include <limits>

namespace pallax {

namespace {

constexpr auto kRRCStates = std::to_array<std::string_view>({
    "Disconnected",
    "Connecting",
    "CELL_FACH",
    "CELL_DCH",
    "CELL_PCH",
    "URA_PCH",
});
static_assert(kRRCStates.size() == 6);

constexpr auto kStateFields = std::to_array<Field>({
    {"RRC State", u8At(13), Conversion::label(kRRCStates), "State of the RRC connection."},
});

constexpr Position kPowerCount = u8At(14);
constexpr Position kRawPower = s16At(4);
constexpr auto kPowerEntryFields = std::to_array<Field>({{"", kRawPower, Conversion::number()}});
constexpr auto kPowerEntries = std::to_array<ListLayout>({{
    .entries = {{.start = 16, .stride = 14, .bytesRead = 6}},
    .count = kPowerCount,
    .fields = kPowerEntryFields,
    .isShown = false,
}});

int transmitPower_dbm(std::int64_t raw) {
    constexpr int kRawOffset = 512;
    constexpr int kStepsPerDb = 10;
    constexpr int kOffsetDb = 70;
    return (static_cast<int>(raw) + kRawOffset) / kStepsPerDb - kOffsetDb;
}

constexpr NumberFormat kMeanDbm{"%4.2lf dBm"};

/// The mean over the entries with a power; NaN if there are none.
PropertyList meanTransmitPower(const Place& place) {
    const EntryList entries = kPowerEntries.front().entriesIn(place.here);
    int sum_dbm = 0;
    int counted = 0;
    const std::size_t whole = entries.wholeCount();
    for (std::size_t index = 0; index < whole; ++index) {
        const std::int64_t raw = entries.at(index).read(kRawPower);
        if (raw != 0) {
            sum_dbm += transmitPower_dbm(raw);
            ++counted;
        }
    }
    const double mean_dbm = counted != 0 ? static_cast<double>(sum_dbm) / counted
                                         : std::numeric_limits<double>::quiet_NaN();
    return DisplayNumber(mean_dbm, kMeanDbm);
}

constexpr auto kReadForPower = std::to_array<Extent>({extentOf(kPowerCount)});
constexpr Computation kMeanPower{
    .name = "mean power",
    .formula = "the mean of (v + 512) / 10 toward zero - 70 over the entries whose raw power v is "
               "not 0; of none, it is no number",
    .read = kReadForPower,
    .compute = meanTransmitPower,
};

constexpr auto kPowerFields = std::to_array<Field>({
    computed("Transmit Power", kMeanDbm, kMeanPower, "Mean transmit power of the phone."),
});

constexpr std::string_view kCellIdKey = "Cell ID";
constexpr std::string_view kUarfcnKey = "UARFCN";

constexpr auto kIdentityFields = std::to_array<Field>({
    {kCellIdKey, s32At(21), Conversion::number(), "Identity of the serving cell."},
    {"Downlink Frequency", s32At(17), Conversion::number(), "UARFCN of the downlink carrier."},
    {"Uplink Frequency", s32At(13), Conversion::number(), "UARFCN of the uplink carrier."},
    {"URA ID", u16At(25), Conversion::number(), "Identity of the UTRAN registration area."},
});

/// The cell monitor's value for the previous cell.
constexpr auto kForeignKeys = std::to_array<std::string_view>({kUarfcnKey});

constexpr auto kCipheringFields = std::to_array<Field>({
    {"Ciphering", u8At(13), Conversion::flag("Enabled", "Disabled"),
     "Whether the radio link is ciphered."},
});

constexpr auto kCellFields = std::to_array<Field>({
    cellNumber(kCellIdKey, kHXCellMonitorCellId, "UMTSRRInfo: Failed to retrieve Cell ID\n"),
    cellNumber(kUarfcnKey, kHXCellMonitorUARFCN, "UMTSRRInfo: Failed to retrieve UARFCN\n",
               "UARFCN that the telephony service gives for the serving cell."),
    cellNumber("Scrambling Code", kHXCellMonitorSCN,
               "UMTSRRInfo: Failed to retrieve Scrambling Code\n",
               "Primary scrambling code of the serving cell."),
});
constexpr auto kTechnologies =
    std::to_array<std::string_view>({kHXCellMonitorRadioAccessTechnologyUMTS});
constexpr ListPart kServingCell{
    .kind = ListPart::Kind::FirstCell,
    .parse = parseCellMonitorArray,
    .technologies = kTechnologies,
    .cellType = kHXCellMonitorCellTypeServing,
};

constexpr auto kCodes = std::to_array<CodeLayout>({
    {
        .logCode = 0x4125,
        .name = "State of the RRC connection",
        .minimumLength = 14,
        .fields = kStateFields,
    },
    {
        .logCode = 0x4031,
        .name = "Transmit power of UMTS",
        .minimumLength = 16,
        .fields = kPowerFields,
        .lists = kPowerEntries,
    },
    {
        .logCode = 0x4127,
        .name = "Identity of the UMTS serving cell",
        .minimumLength = 29,
        .fields = kIdentityFields,
        .removes = kForeignKeys,
        .note = "Removes \"UARFCN\", which is of the cell before.",
    },
    {
        .logCode = 0x4157,
        .name = "Ciphering of UMTS",
        .minimumLength = 19,
        .fields = kCipheringFields,
    },
    {
        .logCode = kCellMonitorLogCode,
        .fields = kCellFields,
        .listPart = &kServingCell,
    },
});

constexpr RecordLayout kLayout{
    .section = "UMTS RR Info",
    .logLine = "UMTSRRInfo",
    .meaning = "State of the UMTS radio link, and the identity of its serving cell.",
    .codes = kCodes,
};

} // namespace

UMTSRRInfo::UMTSRRInfo() : LayoutRecord(kLayout) {}

} // namespace pallax
