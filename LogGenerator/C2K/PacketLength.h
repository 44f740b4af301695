#pragma once

#include "LogGenerator/Records/Layout.h"

namespace pallax {

/// Whether the packet has the length that its layout requires; if not, this is logged.
bool hasLength(const CodeLayout& code, const LogRecord& packet);

} // namespace pallax
