#pragma once

#include "ui/contents/CurveReading.h"
#include "ui/contents/Graph.h"
#include "ui/contents/ShownValues.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// A curve of the graph, with what its legend says.
struct GraphCurve {
    std::size_t number = 0; ///< among all curves, from 0
    std::string mark;       ///< a letter, which tells it from others: "a"
    std::string value;      ///< "-92.25 dBm": now, or at the cursor; "no value"
    std::string name;       ///< "Measured RSRP, Physical Cell ID 275, Neighbor Cells List"
    Curve curve;
};

/// Curves that have a unit, and so a plot, in common.
struct GraphPlot {
    std::string unit;
    std::vector<GraphCurve> curves;
};

inline constexpr const char* kOnlyNumbers = "Only numbers have a curve.";
inline constexpr const char* kNoValueHere = "Nothing to show here: choose a value.";

/// Adds the value at a path of the display to the graph or, if it is there, takes it away. Returns
/// a sentence about it.
std::string toggleInGraph(Graph& graph, ShownValues& shown, std::string_view path);

/// The curves of the graph at the shown instant, with at least so many points. Values of another
/// technology are left out.
std::vector<GraphPlot> graphPlots(ShownValues& shown, const Graph& graph,
                                  const CurveReading& reading, std::size_t points);

/// The time that is shown, or that of the cursor and what happened there.
std::string graphWords(const ShownValues& shown, const CurveReading& reading);

} // namespace pallax
