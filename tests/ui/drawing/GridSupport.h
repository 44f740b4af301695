#pragma once

#include "ui/drawing/Grid.h"
#include "ui/drawing/TextWidth.h"

#include <optional>
#include <ostream>
#include <string>

namespace pallax::terminal {

inline void PrintTo(const Style& style, std::ostream* out) { // NOLINT: gtest's name
    *out << '{' << (style.bold ? " bold" : "") << (style.dim ? " dim" : "")
         << (style.underline ? " underline" : "") << (style.accent ? " accent" : "")
         << (style.tint == Tint::None ? "" : " tint ");
    if (style.tint != Tint::None) {
        *out << static_cast<int>(style.tint);
    }
    *out << " }";
}

/// The style in which the first occurrence of a text begins; nothing if the grid lacks the text.
inline std::optional<Style> styleOf(const Grid& grid, const std::string& wanted) {
    for (int y = 0; y < grid.rows(); ++y) {
        for (int x = 0; x < grid.columns(); ++x) {
            std::string text;
            for (int column = x; column < grid.columns() && text.size() < wanted.size(); ++column) {
                text += grid.at(column, y).text;
            }
            if (text == wanted) {
                return grid.at(x, y).style;
            }
        }
    }
    return std::nullopt;
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
