#pragma once

#include <span>
#include <string_view>

namespace pallax::terminal {

/// Where keys can be pressed. A value is one bit. Modems: where there are several.
enum class HelpPlace : unsigned { Panes = 1, Pages = 2, Save = 4, Modems = 8 };

/// Keys and what they do, as the help page and the manual list them.
struct KeyHelp {
    std::string_view keys; ///< alternatives, separated by blanks
    std::string_view meaning;
    unsigned places = ~0U; ///< the bits of the HelpPlaces in which they work

    bool worksIn(HelpPlace place) const { return (places & static_cast<unsigned>(place)) != 0; }
};

std::span<const KeyHelp> keyHelp();

} // namespace pallax::terminal
