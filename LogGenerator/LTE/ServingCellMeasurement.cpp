#include "LogGenerator/LTE/ServingCellMeasurement.h"

#include "LogGenerator/LTE/SharedLTERecords.h"

#include <array>

namespace pallax {

namespace {

constexpr Conversion kRsrp = Conversion::number(kLevelDbm, 0.25, -140.0);
constexpr Conversion kRsrq = Conversion::number(kLevelDb, 0.25, -30.0);
constexpr Conversion kRssi = Conversion::number(kLevelDbm, 0.5, -140.0);
constexpr Conversion kPowerLimit =
    Conversion::number(kDecimalDbm, 1.0, -30.0).except(64, "Not Present");

/// The conversion of a search threshold; 32 means none.
constexpr Conversion searchThreshold(const NumberFormat& format) {
    return Conversion::number(format, 2.0).except(32, "Not Present");
}

constexpr auto kFields = std::to_array<Field>({
    {"Version", u8At(13), Conversion::number(), "Version of the log record's layout."},
    {"E-ARFCN", u16At(17), Conversion::number(), "EARFCN of the serving cell's downlink."},
    {"Physical Cell ID", bitsAt(19, 0, 9), Conversion::number(),
     "Physical cell identity of the serving cell."},
    {"Serving Layer Priority", bitsAt(20, 1, 4), Conversion::number(),
     "Reselection priority of the serving frequency, 0 to 7, 7 being the highest."},
    {"Measured RSRP", bitsAt(21, 0, 9), kRsrp,
     "Reference signal received power of the serving cell, as last measured."},
    {"Average RSRP", bitsAt(22, 1, 9), kRsrp,
     "Reference signal received power of the serving cell, averaged."},
    {"Measured RSRQ", bitsAt(23, 2, 7), kRsrq,
     "Reference signal received quality of the serving cell, as last measured."},
    {"Average RSRQ", bitsAt(24, 1, 7), kRsrq,
     "Reference signal received quality of the serving cell, averaged."},
    {"Measured RSSI", bitsAt(25, 0, 9), kRssi,
     "Received signal strength over the carrier's whole bandwidth."},
    {"Qrxlevmin", bitsAt(26, 1, 6), Conversion::number(kDecimalDbm, 2.0, -140.0),
     "Least RSRP that the cell demands of a phone which camps on it."},
    {"P_Max", bitsAt(26, 7, 7), kPowerLimit, "Largest transmit power that the cell allows."},
    {"Max UE Tx Power", bitsAt(27, 6, 6), kPowerLimit,
     "Largest transmit power that the phone may use here."},
    {"Srxlev", bitsAt(29, 0, 7), Conversion::number(kDecimalDbm, 1.0, -30.0),
     "Cell-selection receive level: by how much the level exceeds what the cell demands."},
    {"Num of Consecutive DRX Cycles of S < 0", bitsAt(29, 7, 6), Conversion::number(),
     "Number of consecutive DRX cycles in which the selection criterion S was not met."},
    {"S Intra Search", bitsAt(30, 5, 6), searchThreshold(kDecimalDb),
     "Srxlev below which cells of the same frequency are measured."},
    {"S Non Intra Search", bitsAt(31, 3, 6), searchThreshold(kDecimalDbm),
     "Srxlev below which other frequencies and technologies are measured."},
    {"Measurement Rules Updated", bitsAt(32, 1, 1), Conversion::flag("True", "False"),
     "Whether the measurement rules have changed."},
    {"Measurement Rules", bitsAt(32, 2, 4), Conversion::number(),
     "Number of the measurement rules that are in force; the meaning of the values is not known."},
});
static_assert(kFields.size() == 18);

constexpr auto kCodes = std::to_array<CodeLayout>({{
    .logCode = 0xB17F,
    .name = "Idle-mode measurement of the serving cell",
    .minimumLength = 33,
    .fields = kFields,
}});

constexpr RecordLayout kLayout{
    .section = "Serving Cell Measurements",
    .logLine = "Serving Cell Measurements",
    .meaning = "Idle-mode measurement of the serving cell and the parameters of its cell "
               "selection.",
    .codes = kCodes,
};

} // namespace

ServingCellMeasurement::ServingCellMeasurement() : LayoutRecord(kLayout) {}

} // namespace pallax
