#pragma once

#include <cstddef>
#include <string_view>

namespace pallax {

/// The position of the first `wanted` in `text`, ignoring the case of ASCII letters, or npos.
std::size_t findIgnoringCase(std::string_view text, std::string_view wanted);

} // namespace pallax
