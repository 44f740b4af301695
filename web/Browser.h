#pragma once

#include <optional>
#include <string>

namespace pallax {

/// Opens a link in the user's browser (xdg-open) and does not wait for it. Returns why that fails:
/// one sentence.
std::optional<std::string> openInBrowser(const std::string& link);

} // namespace pallax
