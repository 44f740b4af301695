#pragma once

#include "LogGenerator/Records/Layout.h"

namespace pallax {

/// Whether the packet has the length that its layout demands; logs it when it has not.
bool hasLength(const CodeLayout& code, const LogRecord& packet);

} // namespace pallax
