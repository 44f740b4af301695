#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace pallax::terminal {

/// The content of one position on a terminal: a character and the combining characters after it, or
/// one character of an escape (text/Printable).
struct Cluster {
    std::string text;       ///< UTF-8; unprintable input is replaced by U+FFFD
    int columns = 1;        ///< 1, or 2 for a wide character
    std::size_t offset = 0; ///< offset of its first byte in the text
    std::size_t bytes = 0;  ///< its bytes in the text; for an escape, those of the escaped
                            ///< character
};

/// Splits a text into clusters. A byte that is not UTF-8 becomes U+FFFD; a combining character
/// without a base is put on a blank.
std::vector<Cluster> clustersOf(std::string_view text);

/// The width of the text in columns.
int columnsOf(std::string_view text);

/// Wraps a text at blanks into lines of at most this width; longer words stay whole.
std::vector<std::string> wrappedText(std::string_view text, int columns);

} // namespace pallax::terminal
