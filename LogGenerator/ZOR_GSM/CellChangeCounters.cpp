#include "LogGenerator/ZOR_GSM/CellChangeCounters.h"

#include "LogGenerator/Records/Description.h"
#include "platform/SystemLog.h"

namespace pallax {

void CellChangeCounters::updateWithData(const LogRecord& /*record*/, LogCode /*logCode*/) {
    systemLog(LogPriority::Warning, "CellChangeCounters");
}

RecordDescription CellChangeCounters::describe() const {
    return {};
}

} // namespace pallax
