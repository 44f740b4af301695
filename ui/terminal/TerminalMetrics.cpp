#include "ui/terminal/TerminalMetrics.h"

#include "ui/drawing/TextWidth.h"

namespace pallax::terminal {

ui::Size TerminalMetrics::measure(std::string_view text, const ui::Font& /*font*/) const {
    return {columnsOf(text) * kPointsPerColumn, kPointsPerRow};
}

} // namespace pallax::terminal
