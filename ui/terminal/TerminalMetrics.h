#pragma once

#include "platform/ui/TextMetrics.h"

namespace pallax::terminal {

/// A column is so many points wide, so that the margins and gaps of the layouts (10 and 50
/// points) are whole columns.
inline constexpr double kPointsPerColumn = 10;
/// A row is as high as a row of a table.
inline constexpr double kPointsPerRow = 50;

constexpr int columnOf(double x) {
    return static_cast<int>(x / kPointsPerColumn);
}

/// On a terminal every font is as wide as any other.
class TerminalMetrics final : public ui::TextMetrics {
public:
    ui::Size measure(std::string_view text, const ui::Font& font) const override;
};

} // namespace pallax::terminal
