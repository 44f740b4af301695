#include "LogGenerator/Common/CellMonitor.h"

#include "platform/SystemLog.h"

#include <utility>

namespace pallax {

std::optional<PropertyList> parseCellMonitorArrayQuietly(const LogRecord& record) {
    PropertyListResult parsed = record.payloadAsPropertyList();
    if (!parsed) {
        systemLog(LogPriority::Error, "Cell Info Array data could not be constructed");
        return std::nullopt;
    }
    return std::move(parsed).value();
}

std::optional<PropertyList> parseCellMonitorArray(const LogRecord& record) {
    std::optional<PropertyList> cells = parseCellMonitorArrayQuietly(record);
    if (!cells) {
        systemLog(LogPriority::Error, "Failed to get Cell Array\n");
    }
    return cells;
}

} // namespace pallax
