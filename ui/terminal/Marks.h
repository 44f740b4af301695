#pragma once

#include <array>
#include <string_view>

namespace pallax::terminal {

/// The marks that are drawn beside texts, each one column wide, and what joins them.
struct Marks {
    bool asciiOnly;
    std::string_view cursor;     ///< before the row where the user is
    std::string_view disclosure; ///< behind a row that opens
    std::string_view changed;    ///< behind a value that the last tick changed
    std::string_view more;       ///< where a text goes on beyond the edge
    std::string_view up;         ///< before the number of rows above the window
    std::string_view down;       ///< before that of the rows below it
    std::string_view crumb;      ///< between the panes of the way here
    std::string_view dot;        ///< between technology and source
    std::string_view check;
    std::string_view horizontal;
    std::string_view vertical;
    std::string_view topLeft;
    std::string_view topRight;
    std::string_view bottomLeft;
    std::string_view bottomRight;
    std::array<std::string_view, 4> spinner;
};

inline constexpr Marks kUtf8Marks{false,
                                  "▌",
                                  "›",
                                  "*",
                                  "…",
                                  "↑",
                                  "↓",
                                  " › ",
                                  " · ",
                                  "✓",
                                  "─",
                                  "│",
                                  "┌",
                                  "┐",
                                  "└",
                                  "┘",
                                  {"⠋", "⠹", "⠴", "⠧"}};

inline constexpr Marks kAsciiMarks{true,
                                   ">",
                                   ">",
                                   "*",
                                   "~",
                                   "^",
                                   "v",
                                   " > ",
                                   ", ",
                                   "x",
                                   "-",
                                   "|",
                                   "+",
                                   "+",
                                   "+",
                                   "+",
                                   {"|", "/", "-", "\\"}};

} // namespace pallax::terminal
