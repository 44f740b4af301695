#include "LogGenerator/ZOR_GSM/CodingScheme.h"

#include "LogGenerator/Records/Description.h"
#include "platform/SystemLog.h"

namespace pallax {

void CodingScheme::updateWithData(const LogRecord& /*record*/, LogCode /*logCode*/) {
    systemLog(LogPriority::Warning, "CellChangeCounters"); // the line of the counters, on purpose
}

RecordDescription CodingScheme::describe() const {
    return {};
}

} // namespace pallax
