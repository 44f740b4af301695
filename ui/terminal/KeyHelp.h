#pragma once

#include <span>
#include <string_view>

namespace pallax::terminal {

/// Keys and what they do, as the help page and the manual list them.
struct KeyHelp {
    std::string_view keys; ///< alternatives, separated by blanks
    std::string_view meaning;
};

std::span<const KeyHelp> keyHelp();

} // namespace pallax::terminal
