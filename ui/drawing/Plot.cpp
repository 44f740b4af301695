#include "ui/drawing/Plot.h"

#include "ui/drawing/Dots.h"
#include "ui/drawing/TextWidth.h"

#include <algorithm>
#include <cmath>
#include <string_view>

namespace pallax::terminal {

namespace {

constexpr Style kPaleAxis{.dim = true};
constexpr Style kCursorColumn{.accent = true};
constexpr int kMarkColumns = 2; // a blank and the mark of a curve

struct ValueRange {
    double least = 0;
    double most = 0;
};

std::optional<ValueRange> rangeOf(const Curve& curve) {
    std::optional<ValueRange> range;
    for (const CurvePoint& point : curve.points) {
        range = range ? ValueRange{std::min(range->least, point.least),
                                   std::max(range->most, point.most)}
                      : ValueRange{point.least, point.most};
    }
    return range;
}

/// The place of a time among `count` columns or dots.
int placeOf(Time time, Time from, Time to, int count) {
    const double span = std::chrono::duration<double>(to - from).count();
    const double share = std::chrono::duration<double>(time - from).count();
    const double place = span > 0 ? share / span * count : 0.0;
    return static_cast<int>(std::clamp(place, 0.0, std::max(count - 1.0, 0.0)));
}

/// Sets the dots of a curve. Points that are far apart are not joined.
class CurveDots {
public:
    CurveDots(Dots& dots, ValueRange range, Time from, Time to)
        : _dots(dots), _range(range), _from(from), _to(to) {}

    void draw(const Curve& curve) {
        const CurvePoint* before = nullptr;
        for (const CurvePoint& point : curve.points) {
            const int x = xOf(point);
            if (before != nullptr && point.time - before->time <= curve.gap) {
                _dots.line(xOf(*before), rowOf(before->last), x, rowOf(point.first));
            }
            _dots.line(x, rowOf(point.least), x, rowOf(point.most));
            before = &point;
        }
    }
    int rowOf(double value) const {
        const double share =
            _range.most > _range.least ? (_range.most - value) / (_range.most - _range.least) : 0.5;
        return static_cast<int>(std::lround(std::clamp(share, 0.0, 1.0) * (_dots.down() - 1)));
    }

private:
    int xOf(const CurvePoint& point) const {
        return placeOf(point.time, _from, _to, _dots.across());
    }

    Dots& _dots;
    ValueRange _range;
    Time _from;
    Time _to;
};

ValueAxis axisOf(const Plot& plot, int rows) {
    constexpr int kRowsPerLabel = 3;
    std::optional<ValueRange> all;
    for (const PlotCurve& each : plot.curves) {
        if (const auto range = rangeOf(each.curve)) {
            all = all ? ValueRange{std::min(all->least, range->least),
                                   std::max(all->most, range->most)}
                      : *range;
        }
    }
    const ValueRange range = all.value_or(ValueRange{0, 1});
    return valueAxis(range.least, range.most, rows / kRowsPerLabel + 1);
}

/// A row of one dot for each column would always look the same.
std::string asciiSparkline(const Curve& curve, ValueRange range, Time from, Time to, int columns) {
    constexpr std::string_view kLevels = "_.-'"; // from the least to the greatest value
    std::string text(static_cast<std::size_t>(columns), ' ');
    const CurvePoint* before = nullptr;
    for (const CurvePoint& point : curve.points) {
        const auto column = static_cast<std::size_t>(placeOf(point.time, from, to, columns));
        const double share = range.most > range.least
                                 ? (point.last - range.least) / (range.most - range.least)
                                 : 0.5;
        if (before != nullptr && point.time - before->time <= curve.gap) {
            const auto start = static_cast<std::size_t>(placeOf(before->time, from, to, columns));
            std::fill(text.begin() + static_cast<std::ptrdiff_t>(start),
                      text.begin() + static_cast<std::ptrdiff_t>(column), text[start]);
        }
        text[column] =
            kLevels[static_cast<std::size_t>(std::lround(share * (kLevels.size() - 1.0)))];
        before = &point;
    }
    return text;
}

/// Draws one plot into its area.
class PlotDrawing {
public:
    PlotDrawing(Grid& grid, const Marks& marks, const Plot& plot, PlotArea area, int labels)
        : _grid(grid), _marks(marks), _plot(plot), _area(area), _left(area.x + labels),
          _columns(curveColumns(plot, area.columns, labels)), _rows(area.rows - 1),
          _axis(axisOf(plot, _rows)), _dots(_columns, _rows, marks.curves),
          _curves(_dots, {_axis.least, _axis.most}, plot.from, plot.to) {}

    void draw() {
        drawLines();
        drawCurves();
        drawValueAxis();
        drawTimeAxis();
    }

private:
    int columnAt(Time time) const { return _left + placeOf(time, _plot.from, _plot.to, _columns); }
    int rowAt(double value) const {
        return _area.y + _curves.rowOf(value) / dotsPerCell(_marks.curves).down;
    }

    /// The line of the cursor and the marks of events above the time axis, below the curves.
    void drawLines() {
        for (const CurveEvent& event : _plot.events) {
            _grid.put(columnAt(event.time), _area.y + _rows - 1, _marks.event, kPaleAxis);
        }
        for (int y = _area.y; _plot.cursor && y < _area.y + _rows; ++y) {
            _grid.put(columnAt(*_plot.cursor), y, _marks.vertical, kCursorColumn);
        }
    }

    void drawCurves() {
        const std::vector<std::optional<Tint>> tints = drawDots();
        const int cursor = _plot.cursor ? columnAt(*_plot.cursor) - _left : -1;
        for (int row = 0; row < _rows; ++row) {
            for (int column = 0; column < _columns; ++column) {
                const std::string text = _dots.textAt(column, row);
                if (!text.empty()) {
                    const Style style{.tint = *tints[cellAt(column, row)]};
                    _grid.put(_left + column, _area.y + row, text,
                              column == cursor ? kCursorColumn : style);
                }
            }
        }
        drawMarks();
    }

    std::size_t cellAt(int column, int row) const {
        return static_cast<std::size_t>(row) * static_cast<std::size_t>(_columns) +
               static_cast<std::size_t>(column);
    }

    /// Returns the tint of each cell that has dots: that of the first curve in it.
    std::vector<std::optional<Tint>> drawDots() {
        std::vector<std::optional<Tint>> first(cellAt(0, _rows));
        for (const PlotCurve& each : _plot.curves) {
            _curves.draw(each.curve);
            for (int row = 0; row < _rows; ++row) {
                for (int column = 0; column < _columns; ++column) {
                    std::optional<Tint>& tint = first[cellAt(column, row)];
                    tint = !tint && !_dots.textAt(column, row).empty() ? each.tint : tint;
                }
            }
        }
        return first;
    }

    /// The mark of each curve at its end, or in the next free row.
    void drawMarks() {
        std::vector<bool> taken(static_cast<std::size_t>(std::max(_rows, 0)));
        for (const PlotCurve& each : _plot.curves) {
            if (each.mark.empty() || each.curve.points.empty() || _rows <= 0) {
                continue;
            }
            auto row = static_cast<std::size_t>(rowAt(each.curve.points.back().last) - _area.y);
            for (std::size_t tried = 0; taken[row] && tried < taken.size(); ++tried) {
                row = (row + 1) % taken.size();
            }
            taken[row] = true;
            _grid.put(_left + _columns + kMarkColumns - 1, _area.y + static_cast<int>(row),
                      each.mark, {.bold = true, .tint = each.tint});
        }
    }

    void drawValueAxis() {
        for (int y = _area.y; y < _area.y + _rows; ++y) {
            _grid.put(_left - 1, y, _marks.vertical, kPaleAxis);
        }
        for (const double label : _axis.labels) {
            const std::string text = _axis.textOf(label);
            const int y = rowAt(label);
            _grid.clear(_area.x, y, _left - 1 - _area.x, 1); // of a label in the same row
            _grid.put(_left - kMarkColumns - columnsOf(text), y, text, kPaleAxis);
            _grid.put(_left - 1, y, _marks.tick, kPaleAxis);
        }
    }

    void drawTimeAxis() {
        const int y = _area.y + _rows;
        const int end = _left + _columns;
        const Span room{_area.x, end};
        _grid.put(_left - kMarkColumns - columnsOf(_plot.unit), y, _plot.unit, kPaleAxis, room);
        _grid.put(_left - 1, y, _marks.bottomLeft, kPaleAxis);
        _grid.fill({_left, end}, y, _marks.horizontal, kPaleAxis);
        for (const CurveEvent& event : _plot.events) {
            _grid.put(columnAt(event.time), y, _marks.event);
        }
        for (const TimeLabel& label : timeLabels(_plot.from, _plot.to, _plot.ahead, _columns)) {
            const int width = columnsOf(label.text) + 2;
            const int x = columnAt(label.time) - width / 2;
            if (x >= _left && x + width <= end) {
                _grid.put(x + 1, y, label.text, kPaleAxis);
                _grid.put(x, y, " ");
                _grid.put(x + width - 1, y, " ");
            }
        }
    }

    Grid& _grid;
    const Marks& _marks;
    const Plot& _plot;
    PlotArea _area;
    int _left;
    int _columns;
    int _rows;
    ValueAxis _axis;
    Dots _dots;
    CurveDots _curves;
};

} // namespace

bool Plot::isEmpty() const {
    return std::all_of(curves.begin(), curves.end(),
                       [](const PlotCurve& each) { return each.curve.points.empty(); });
}

int labelColumns(const Plot& plot, int rows) {
    int columns = columnsOf(plot.unit);
    const ValueAxis axis = axisOf(plot, rows - 1);
    for (const double label : axis.labels) {
        columns = std::max(columns, columnsOf(axis.textOf(label)));
    }
    return columns + 2; // a blank and the axis
}

int curveColumns(const Plot& plot, int columns, int labels) {
    const bool hasMarks = std::any_of(plot.curves.begin(), plot.curves.end(),
                                      [](const PlotCurve& each) { return !each.mark.empty(); });
    return columns - labels - (hasMarks ? kMarkColumns : 0);
}

void drawPlot(Grid& grid, const Marks& marks, const Plot& plot, PlotArea area, int labels) {
    constexpr int kLeastPlotRows = 2; // one for a curve, one for the time
    if (area.rows >= kLeastPlotRows && curveColumns(plot, area.columns, labels) > 0) {
        PlotDrawing(grid, marks, plot, area, labels).draw();
    }
}

std::string sparkline(const Marks& marks, const Curve& curve, Time from, Time to, int columns) {
    const auto range = rangeOf(curve);
    if (!range || columns <= 0) {
        return "";
    }
    if (marks.curves == Curves::Ascii) {
        return asciiSparkline(curve, *range, from, to, columns);
    }
    Dots dots(columns, 1, marks.curves);
    CurveDots(dots, *range, from, to).draw(curve);
    std::string text;
    for (int column = 0; column < columns; ++column) {
        const std::string cell = dots.textAt(column, 0);
        text += cell.empty() ? " " : cell;
    }
    return text;
}

} // namespace pallax::terminal
