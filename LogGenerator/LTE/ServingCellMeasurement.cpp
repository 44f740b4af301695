#include "LogGenerator/LTE/ServingCellMeasurement.h"

#include "LogGenerator/LTE/SharedLTERecords.h"
#include "LogGenerator/Records/Description.h"
#include "platform/SystemLog.h"

#include <array>

namespace pallax {

namespace {

constexpr std::size_t kMinimumLength = 33;

constexpr Conversion kRsrp = Conversion::number(kLevelDbm, 0.25, -140.0);
constexpr Conversion kRsrq = Conversion::number(kLevelDb, 0.25, -30.0);
constexpr Conversion kRssi = Conversion::number(kLevelDbm, 0.5, -140.0);
constexpr Conversion kPowerLimit =
    Conversion::number(kDecimalDbm, 1.0, -30.0).except(64, "Not Present");

/// Of a search threshold; 32 stands for none.
constexpr Conversion searchThreshold(const NumberFormat& format) {
    return Conversion::number(format, 2.0).except(32, "Not Present");
}

constexpr auto kFields = std::to_array<Field>({
    {"Version", u8At(13), Conversion::number()},
    {"E-ARFCN", u16At(17), Conversion::number()},
    {"Physical Cell ID", bitsAt(19, 0, 9), Conversion::number()},
    {"Serving Layer Priority", bitsAt(20, 1, 4), Conversion::number()},
    {"Measured RSRP", bitsAt(21, 0, 9), kRsrp},
    {"Average RSRP", bitsAt(22, 1, 9), kRsrp},
    {"Measured RSRQ", bitsAt(23, 2, 7), kRsrq},
    {"Average RSRQ", bitsAt(24, 1, 7), kRsrq},
    {"Measured RSSI", bitsAt(25, 0, 9), kRssi},
    {"Qrxlevmin", bitsAt(26, 1, 6), Conversion::number(kDecimalDbm, 2.0, -140.0)},
    {"P_Max", bitsAt(26, 7, 7), kPowerLimit},
    {"Max UE Tx Power", bitsAt(27, 6, 6), kPowerLimit},
    {"Srxlev", bitsAt(29, 0, 7), Conversion::number(kDecimalDbm, 1.0, -30.0)},
    {"Num of Consecutive DRX Cycles of S < 0", bitsAt(29, 7, 6), Conversion::number()},
    {"S Intra Search", bitsAt(30, 5, 6), searchThreshold(kDecimalDb)},
    {"S Non Intra Search", bitsAt(31, 3, 6), searchThreshold(kDecimalDbm)},
    {"Measurement Rules Updated", bitsAt(32, 1, 1), Conversion::flag("True", "False")},
    {"Measurement Rules", bitsAt(32, 2, 4), Conversion::number()},
});
static_assert(kFields.size() == 18);

constexpr auto kGroups = std::to_array<FieldGroup>({{0xB17F, kMinimumLength, kFields}});
constexpr auto kLogCodes = logCodesOf(kGroups);

} // namespace

std::span<const LogCode> ServingCellMeasurement::getLogCodeArray() const {
    return kLogCodes;
}

void ServingCellMeasurement::updateWithData(const LogRecord& record, LogCode logCode) {
    systemLog(LogPriority::Warning, "Serving Cell Measurements");
    showGroup(kGroups, record, logCode);
}

bool ServingCellMeasurement::replacesShown(const LogRecord& record, LogCode logCode) const {
    return isOfGroup(kGroups, record, logCode);
}

RecordDescription ServingCellMeasurement::describe() const {
    return describeGroups(kGroups);
}

} // namespace pallax
