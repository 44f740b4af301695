#pragma once

#include "overview/Differences.h"

#include <string>
#include <vector>

namespace pallax {

/// A line with a JSON object for each difference.
void appendDifferencesJson(std::string& out, const std::vector<Difference>& differences);

} // namespace pallax
