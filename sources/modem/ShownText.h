#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace pallax {

/// A text of the bus as it is shown: its first `kLongestShown` bytes, with "…" in place of the
/// rest, and with each invalid byte replaced.
std::string shownText(std::string_view text);

inline constexpr std::size_t kLongestShown = 256;

} // namespace pallax
