#pragma once

#include "text/Result.h"

#include <chrono>
#include <string>

namespace pallax {

/// "0.5", "3600": above 0 and up to 1000000000; otherwise an error.
Result<std::chrono::nanoseconds, std::string> parseSeconds(const std::string& text);

/// The same, with or without the unit: "10", "10s".
Result<std::chrono::nanoseconds, std::string> parseSecondsWithUnit(std::string text);

} // namespace pallax
