#pragma once

#include "ui/drawing/Keys.h"

#include <optional>
#include <string_view>

namespace pallax::terminal {

/// Makes the terminal report the mouse: its button, its wheel, and where it is while the button is
/// held. The curses library asks for no motion, and of reports that come at once it returns only
/// the last. Nothing is reported while the program is suspended, because the shell does not expect
/// it. One at a time, while the library has its screen.
class MouseReports {
public:
    MouseReports();
    ~MouseReports();
    MouseReports(const MouseReports&) = delete;
    MouseReports& operator=(const MouseReports&) = delete;

    /// Asks again, when the program may have been suspended.
    static void ask();
};

/// Ends all reports of the mouse.
inline constexpr std::string_view kNoMouseReports = "\x1b[?1000l\x1b[?1002l\x1b[?1003l\x1b[?1006l";

/// The event of a report, "<" with three numbers, and its final character: "<0;12;24" and "M".
/// Nothing for reports that have no meaning here, such as other buttons.
std::optional<KeyEvent> mouseEvent(std::string_view parameters, char32_t final);

/// The event of a report of terminals that send three characters instead.
std::optional<KeyEvent> mouseEventOfCharacters(char32_t what, char32_t column, char32_t row);

} // namespace pallax::terminal
