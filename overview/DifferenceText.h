#pragma once

#include "overview/Differences.h"

#include <string>
#include <vector>

namespace pallax {

/// The differences below the names of their sections and entries, as the display has them.
void appendDifferencesText(std::string& out, const std::vector<Difference>& differences);

} // namespace pallax
