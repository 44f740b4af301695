#include "LogGenerator/Common/LogCode_0xFF000020.h"

#include "platform/SystemLog.h"
#include "plist/PropertyListCodec.h"

namespace pallax {

LogCode_0xFF000020::LogCode_0xFF000020(const LogRecord& record) {
    PropertyListResult parsed = parsePropertyList(record.payload());
    if (!parsed) {
        systemLog(LogPriority::Error, "SIM File dictionary data could not be constructed");
        throw UnknownDataException();
    }
    _files = std::move(parsed).value();
}

} // namespace pallax
