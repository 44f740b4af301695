#include "LogGenerator/ZOR_GSM/UMTSRRMeasurement.h"

#include "platform/SystemLog.h"

namespace pallax {

void UMTSRRMeasurement::updateWithData(const LogRecord& /*record*/, LogCode /*logCode*/) {
    systemLog(LogPriority::Warning, "UMTSRRMeasurement");
}

} // namespace pallax
