#include "LogGenerator/ZOR_GSM/CodingScheme.h"

#include "platform/SystemLog.h"

namespace pallax {

void CodingScheme::updateWithData(const LogRecord& /*record*/, LogCode /*logCode*/) {
    systemLog(LogPriority::Warning, "CellChangeCounters"); // the line of the counters, on purpose
}

} // namespace pallax
