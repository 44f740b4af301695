#include "LogGenerator/ZOR_GSM/NonRankedGSMSet.h"

#include "LogGenerator/Records/Description.h"
#include "platform/SystemLog.h"

namespace pallax {

void NonRankedGSMSet::updateWithData(const LogRecord& /*record*/, LogCode /*logCode*/) {
    systemLog(LogPriority::Warning, "NonRankedGSMSet");
}

RecordDescription NonRankedGSMSet::describe() const {
    return {};
}

} // namespace pallax
