#pragma once

#include "platform/Clock.h"

#include <string>

/// Local times as texts.
namespace pallax {

/// Local time minus UTC in hours and minutes: "+0200", "-0330".
std::string zoneText(const Clock::Zone& zone);

/// "2023-11-14 23:13:20 +0100": the local time, to the second.
std::string localTimeText(Time time, const Clock& clock);

} // namespace pallax
