#pragma once

#include "platform/Clock.h"

#include <string>

namespace pallax {

/// Local time minus UTC in hours and minutes: "+0200", "-0330".
std::string zoneText(const Clock::Zone& zone);

} // namespace pallax
