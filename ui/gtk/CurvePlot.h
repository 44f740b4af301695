#pragma once

#include "timeline/Curve.h"
#include "ui/gtk/Ref.h"
#include "ui/gtk/Signals.h"

#include <chrono>
#include <functional>
#include <gtk/gtk.h>
#include <optional>
#include <string>
#include <utility>
#include <vector>

namespace pallax::gtk {

/// How many places the cursor has in a plot, however wide that is.
inline constexpr int kCursorColumns = 200;
/// How many points a curve has at least, if there are so many numbers.
inline constexpr std::size_t kCurvePoints = 400;

/// Curves in one unit over a time, with axes, marks of events and a cursor.
class CurvePlot {
public:
    struct Line {
        std::string mark;       ///< stands at its end and tells it from others; empty: none
        std::size_t number = 0; ///< chooses its colour and dashes
        Curve curve;
    };
    struct Content {
        Time from;
        Time to;
        std::chrono::seconds ahead{0}; ///< local time minus UTC
        std::string unit;
        std::vector<Line> lines;
        std::vector<CurveEvent> events; ///< marks on the time axis
        std::optional<Time> cursor = {};
    };
    /// A time under the pointer or finger; nothing: the pointer has left.
    using Pointed = std::function<void(std::optional<Time>)>;

    CurvePlot(const Guard& guard, Pointed pointed);
    CurvePlot(const CurvePlot&) = delete;
    CurvePlot& operator=(const CurvePlot&) = delete;

    /// `description` is for screen readers.
    void show(Content content, const std::string& description);
    /// The width of the labels at the left, and how wide they are drawn at least: plots below each
    /// other have a common time axis if all get the greatest width.
    int labelWidth() const;
    void setLabelWidth(int least);
    GtkWidget* widget() const { return GTK_WIDGET(_area.get()); }

private:
    void listen(const Guard& guard);
    void point(double x, bool isHovering);
    void draw(cairo_t* to, int width, int height) const;

    Pointed _pointed;
    Content _content;
    std::string _description;
    int _leastLabelWidth = 0;
    bool _isHovering = false;           ///< the cursor goes with the pointer
    std::pair<double, double> _pointer; ///< where it was last
    Ref<GtkDrawingArea> _area;
};

/// A short line as that of the curve with this number, for a legend.
GtkWidget* curveSwatch(std::size_t number);

} // namespace pallax::gtk
