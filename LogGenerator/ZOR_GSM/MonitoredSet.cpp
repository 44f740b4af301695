#include "LogGenerator/ZOR_GSM/MonitoredSet.h"

namespace pallax {

MonitoredSet::MonitoredSet() : SearcherSet("MonitoredSet") {}

std::string_view MonitoredSet::getSectionName() const {
    return "Monitored Set";
}

} // namespace pallax
