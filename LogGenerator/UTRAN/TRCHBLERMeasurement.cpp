#include "LogGenerator/UTRAN/TRCHBLERMeasurement.h"

#include "LogGenerator/Records/Description.h"
#include "LogGenerator/UTRAN/ChannelQuality.h"
#include "platform/SystemLog.h"

namespace pallax {

namespace {

constexpr auto kFields = std::to_array<Field>({
    {"TRCH ID", u8At(0), Conversion::number()},
    {"TRCH BLER Measurement", u8At(1), Conversion::number()},
});

} // namespace

std::span<const LogCode> TRCHBLERMeasurement::getLogCodeArray() const {
    return kChannelQualityLogCodes;
}

void TRCHBLERMeasurement::updateWithData(const LogRecord& record, LogCode logCode) {
    systemLog(LogPriority::Notice, "TRCH BLER Measurement"); // the one record that notes it
    if (logCode != kChannelQualityLogCode || !record.has(kChannelQualityMinimumLength)) {
        return;
    }
    clearList();
    replaceList(transportChannels(record), [](Dictionary& target, const LogRecord& entry) {
        fillEntry(target, kFields, entry);
    });
}

bool TRCHBLERMeasurement::replacesShown(const LogRecord& record, LogCode logCode) const {
    return logCode == kChannelQualityLogCode && record.has(kChannelQualityMinimumLength);
}

RecordDescription TRCHBLERMeasurement::describe() const {
    CodeDescription code{kChannelQualityLogCode, kChannelQualityMinimumLength};
    code.lists = {describeList("", kTransportChannels, kTransportChannelCount, kFields)};
    return {std::move(code)};
}

} // namespace pallax
