#include "LogGenerator/ZOR_GSM/CellChangeCounters.h"

#include "platform/SystemLog.h"

namespace pallax {

void CellChangeCounters::updateWithData(const LogRecord& /*record*/, LogCode /*logCode*/) {
    systemLog(LogPriority::Warning, "CellChangeCounters");
}

} // namespace pallax
