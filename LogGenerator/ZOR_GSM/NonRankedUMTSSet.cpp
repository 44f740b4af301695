#include "LogGenerator/ZOR_GSM/NonRankedUMTSSet.h"

#include "LogGenerator/Records/Description.h"
#include "platform/SystemLog.h"

namespace pallax {

void NonRankedUMTSSet::updateWithData(const LogRecord& /*record*/, LogCode /*logCode*/) {
    systemLog(LogPriority::Warning, "NonRankedUMTSSet");
}

RecordDescription NonRankedUMTSSet::describe() const {
    return {};
}

} // namespace pallax
