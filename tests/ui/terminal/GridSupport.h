#pragma once

#include "ui/terminal/Grid.h"
#include "ui/terminal/TextWidth.h"

#include <ostream>
#include <string>

namespace pallax::terminal {

inline void PrintTo(const Style& style, std::ostream* out) { // NOLINT: gtest's name
    *out << '{' << (style.bold ? " bold" : "") << (style.dim ? " dim" : "")
         << (style.underline ? " underline" : "") << (style.accent ? " accent" : "") << " }";
}

/// The fault of a grid that a terminal could not show, or "": each cell must contain one printable
/// character, and a wide one must be followed by its right half.
inline std::string faultOf(const Grid& grid) {
    for (int y = 0; y < grid.rows(); ++y) {
        int halves = 0; // right halves still expected
        for (int x = 0; x < grid.columns(); ++x) {
            const std::string& text = grid.at(x, y).text;
            const std::string place = std::to_string(x) + "," + std::to_string(y);
            if (text.empty()) {
                if (halves-- == 0) {
                    return "a right half of nothing at " + place;
                }
                continue;
            }
            const auto clusters = clustersOf(text);
            if (halves != 0 || clusters.size() != 1) {
                return "no single character at " + place;
            }
            if (clusters.front().text != text) {
                return "an unprintable character at " + place;
            }
            halves = clusters.front().columns - 1;
        }
        if (halves != 0) {
            return "half a character at the end of row " + std::to_string(y);
        }
    }
    return "";
}

} // namespace pallax::terminal
