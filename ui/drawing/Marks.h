#pragma once

#include <array>
#include <string_view>

namespace pallax::terminal {

/// What curves are drawn with.
enum class Curves { Braille, Blocks, Ascii };

/// The marks drawn next to texts and between them, each one column wide.
struct Marks {
    bool asciiOnly;
    std::string_view cursor;     ///< before the current row
    std::string_view disclosure; ///< after a row that opens
    std::string_view changed;    ///< after a value that changed since the last tick
    std::string_view old;        ///< after a value whose age has no room
    std::string_view more;       ///< where a text continues beyond the edge
    std::string_view up;         ///< before the number of rows above the window
    std::string_view down;       ///< before the number of rows below the window
    std::string_view crumb;      ///< between the panes of a path
    std::string_view dot;        ///< between technology and source
    std::string_view barFull;    ///< a part of a level's bar
    std::string_view barEmpty;   ///< the rest of the bar
    std::string_view timeBegin;  ///< where a time bar begins
    std::string_view timeEnd;    ///< where it ends
    std::string_view timeShown;  ///< the shown instant in it
    std::string_view timeMark;   ///< the marked instant in it
    std::string_view timeEvent;  ///< an event in it
    std::string_view check;
    std::string_view horizontal;
    std::string_view vertical;
    std::string_view topLeft;
    std::string_view topRight;
    std::string_view bottomLeft;
    std::string_view bottomRight;
    std::array<std::string_view, 4> spinner;
    std::string_view tick;  ///< beside a label of a vertical axis
    std::string_view event; ///< a vertical line where something happened
    Curves curves;
};

inline constexpr Marks kUtf8Marks{false,
                                  "▌",
                                  "›",
                                  "*",
                                  "o",
                                  "…",
                                  "↑",
                                  "↓",
                                  " › ",
                                  " · ",
                                  "▆",
                                  "▁",
                                  "▕",
                                  "▏",
                                  "●",
                                  "◆",
                                  "┴",
                                  "✓",
                                  "─",
                                  "│",
                                  "┌",
                                  "┐",
                                  "└",
                                  "┘",
                                  {"⠋", "⠹", "⠴", "⠧"},
                                  "┤",
                                  "┆",
                                  Curves::Braille};

/// Without braille characters.
inline constexpr Marks kConsoleMarks = [] {
    Marks marks = kUtf8Marks;
    marks.spinner = {"|", "/", "-", "\\"};
    marks.curves = Curves::Blocks;
    return marks;
}();

inline constexpr Marks kAsciiMarks{true, ">", ">",          "*",   "o",
                                   "~",  "^", "v",          " > ", ", ",
                                   "#",  ".", "[",          "]",   "o",
                                   "m",  "'", "x",          "-",   "|",
                                   "+",  "+", "+",          "+",   {"|", "/", "-", "\\"},
                                   "+",  ":", Curves::Ascii};

} // namespace pallax::terminal
