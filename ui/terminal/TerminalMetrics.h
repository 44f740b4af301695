#pragma once

#include "platform/ui/TextMetrics.h"

namespace pallax::terminal {

/// Points per column, so the margins and gaps of the layouts (10 and 50 points) are whole columns.
inline constexpr double kPointsPerColumn = 10;
/// Points per row: the height of a table row.
inline constexpr double kPointsPerRow = 50;

constexpr int columnOf(double x) {
    return static_cast<int>(x / kPointsPerColumn);
}

/// On a terminal all fonts have the same width.
class TerminalMetrics final : public ui::TextMetrics {
public:
    ui::Size measure(std::string_view text, const ui::Font& font) const override;
};

} // namespace pallax::terminal
