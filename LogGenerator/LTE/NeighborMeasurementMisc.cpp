#include "LogGenerator/LTE/NeighborMeasurementMisc.h"

#include "LogGenerator/LTE/SharedLTERecords.h"
#include "LogGenerator/Records/Description.h"
#include "platform/SystemLog.h"

#include <array>

namespace pallax {

namespace {

constexpr auto kFields = std::to_array<Field>({
    {"Version", u8At(13), Conversion::number()},
    {"E-ARFCN", u16At(17), Conversion::number()},
    {"Qrxlevmin", bitsAt(19, 0, 6), Conversion::number(kDecimalDbm, 2.0, -140.0)},
});

constexpr auto kGroups =
    std::to_array<FieldGroup>({{kNeighborMeasurementLogCode, kNeighborMeasurementLength, kFields}});
constexpr auto kLogCodes = logCodesOf(kGroups);

} // namespace

std::span<const LogCode> NeighborMeasurementMisc::getLogCodeArray() const {
    return kLogCodes;
}

void NeighborMeasurementMisc::updateWithData(const LogRecord& record, LogCode logCode) {
    systemLog(LogPriority::Warning, "Neighbor Measurements");
    showGroup(kGroups, record, logCode);
}

bool NeighborMeasurementMisc::replacesShown(const LogRecord& record, LogCode logCode) const {
    return isOfGroup(kGroups, record, logCode);
}

RecordDescription NeighborMeasurementMisc::describe() const {
    return describeGroups(kGroups);
}

} // namespace pallax
