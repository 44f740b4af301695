#pragma once

#include "timeline/Curve.h"
#include "ui/contents/Axes.h"
#include "ui/drawing/Grid.h"
#include "ui/drawing/Marks.h"

#include <chrono>
#include <optional>
#include <string>
#include <vector>

namespace pallax::terminal {

/// A curve in a plot.
struct PlotCurve {
    std::string mark; ///< stands at its end and tells it from others; empty: none
    Curve curve;
    Tint tint = Tint::None;
};

/// Curves of values in one unit over a time.
struct Plot {
    Time from;
    Time to;
    std::chrono::seconds ahead{0}; ///< local time minus UTC
    std::string unit;
    std::vector<PlotCurve> curves;
    std::vector<CurveEvent> events; ///< marks above the time axis
    std::optional<Time> cursor;

    bool isEmpty() const;
};

struct PlotArea {
    int x = 0;
    int y = 0;
    int columns = 0;
    int rows = 0;
};

/// The columns before the curves: those of the labels. Plots below each other have a common time
/// axis if they are drawn with the greatest of theirs.
int labelColumns(const Plot& plot, int rows);
/// How many columns of an area the curves have.
int curveColumns(const Plot& plot, int columns, int labels);

/// Draws the curves with both axes; the time axis is in the last row.
void drawPlot(Grid& grid, const Marks& marks, const Plot& plot, PlotArea area, int labels);

/// A curve in one row, from its least to its greatest value.
std::string sparkline(const Marks& marks, const Curve& curve, Time from, Time to, int columns);

} // namespace pallax::terminal
