#pragma once

#include "browsing/BrowseOptions.h"
#include "cli/Options.h"

#include <string>
#include <variant>
#include <vector>

namespace pallax {

/// What the arguments of pallax-window ask for. They are those of `pallax` that browse; what only a
/// terminal has is refused.
std::variant<BrowseOptions, ParseEnd> windowOptions(std::vector<std::string> arguments);

} // namespace pallax
