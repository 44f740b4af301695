#include "LogGenerator/ZOR_GSM/UMTSRRMeasurement.h"

#include "LogGenerator/Records/Description.h"
#include "platform/SystemLog.h"

namespace pallax {

void UMTSRRMeasurement::updateWithData(const LogRecord& /*record*/, LogCode /*logCode*/) {
    systemLog(LogPriority::Warning, "UMTSRRMeasurement");
}

RecordDescription UMTSRRMeasurement::describe() const {
    return {};
}

} // namespace pallax
