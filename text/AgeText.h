#pragma once

#include <chrono>
#include <string>

namespace pallax {

/// "14 s" below two minutes, then "3 min", "2 h", "5 days".
std::string ageText(std::chrono::nanoseconds age);

} // namespace pallax
