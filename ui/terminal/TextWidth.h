#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace pallax::terminal {

/// What stands in one place on a terminal: a character and the combining ones that follow it, or
/// one character of the escape of what commands a terminal (platform/Printable).
struct Cluster {
    std::string text;       ///< UTF-8; what cannot be shown is replaced by U+FFFD
    int columns = 1;        ///< 1, or 2 for a wide character
    std::size_t offset = 0; ///< of its first byte in the text
    std::size_t bytes = 0;  ///< that it takes there; of an escape, those of what it stands for
};

/// Splits a text into clusters. A byte that is no UTF-8 becomes U+FFFD; a combining character
/// without one before it stands on a blank.
std::vector<Cluster> clustersOf(std::string_view text);

/// How many columns the text takes.
int columnsOf(std::string_view text);

} // namespace pallax::terminal
