#pragma once

#include <cstddef>
#include <string_view>

namespace pallax {

/// Where `wanted` first stands in `text`, ignoring the case of ASCII letters; npos where it does
/// not.
std::size_t findIgnoringCase(std::string_view text, std::string_view wanted);

} // namespace pallax
