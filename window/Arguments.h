#pragma once

#include "browsing/BrowseOptions.h"
#include "cli/Options.h"

#include <optional>
#include <string>
#include <variant>
#include <vector>

namespace pallax {

/// What the arguments of pallax-window ask for. They are those of `pallax` that browse; what only a
/// terminal has is refused.
std::variant<BrowseOptions, ParseEnd> windowOptions(std::vector<std::string> arguments);

/// What two starts have in common that show the same: then the second one brings the first one's
/// window to the front. Nothing for a start that shows what no other can, or writes to its shell.
std::optional<std::string> keyOf(const BrowseOptions& options);

} // namespace pallax
