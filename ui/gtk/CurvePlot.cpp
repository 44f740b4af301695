#include "ui/gtk/CurvePlot.h"

#include "ui/contents/Axes.h"
#include "ui/gtk/CurveInk.h"
#include "ui/gtk/ShownText.h"

#include <algorithm>
#include <utility>

namespace pallax::gtk {

namespace {

constexpr int kPlotHeight = 200;
constexpr int kSwatchWidth = 28;
constexpr int kSwatchHeight = 12;
constexpr double kPlotBorder = 8;
constexpr double kPaleInk = 0.5;
constexpr double kGridPale = 0.15;
constexpr double kPointRadius = 3.5; // the radius of a point under the cursor
constexpr double kEventHeight = 7;

Ref<PangoLayout> layoutOf(GtkWidget* widget, const std::string& text) {
    Ref<PangoLayout> layout(gtk_widget_create_pango_layout(widget, shownText(text).c_str()));
    return layout;
}

struct TextExtent {
    int width = 0;
    int height = 0;
};

TextExtent extentOf(GtkWidget* widget, const std::string& text) {
    TextExtent extent;
    pango_layout_get_pixel_size(layoutOf(widget, text).get(), &extent.width, &extent.height);
    return extent;
}

/// Both ends are the least and greatest number of all lines; 0 and 1 without any.
ValueAxis axisOf(const CurvePlot::Content& content, int labels) {
    std::optional<std::pair<double, double>> range;
    for (const CurvePlot::Line& line : content.lines) {
        for (const CurvePoint& point : line.curve.points) {
            range = range ? std::pair(std::min(range->first, point.least),
                                      std::max(range->second, point.most))
                          : std::pair(point.least, point.most);
        }
    }
    const auto [least, most] = range.value_or(std::pair(0.0, 1.0));
    return valueAxis(least, most, labels);
}

/// Where the curves are in the widget.
struct PlotRoom {
    double left;
    double top;
    double right;
    double bottom;

    double width() const { return std::max(right - left, 1.0); }
};

PlotRoom roomIn(GtkWidget* widget, int labelWidth, const CurvePlot::Content& content, int width,
                int height) {
    const bool hasMarks = std::any_of(content.lines.begin(), content.lines.end(),
                                      [](const auto& line) { return !line.mark.empty(); });
    const TextExtent letter = extentOf(widget, "a");
    return {labelWidth + 2 * kPlotBorder, kPlotBorder + letter.height / 2.0,
            width - kPlotBorder - (hasMarks ? letter.width + kPlotBorder : 0),
            height - kPlotBorder - letter.height - kPlotBorder / 2};
}

/// Draws one plot once.
class PlotDrawing {
public:
    PlotDrawing(cairo_t* to, GtkWidget* widget, const CurvePlot::Content& content,
                const ValueAxis& axis, PlotRoom room)
        : _to(to), _widget(widget), _content(content), _axis(axis), _room(room) {}

    void draw() const {
        drawValueAxis();
        drawTimeAxis();
        drawEvents();
        for (const CurvePlot::Line& line : _content.lines) {
            drawLine(line);
        }
        drawMarks();
        drawCursor();
    }

private:
    double xOf(Time time) const {
        const double span = std::chrono::duration<double>(_content.to - _content.from).count();
        const double share = std::chrono::duration<double>(time - _content.from).count();
        return _room.left + std::clamp(span > 0 ? share / span : 0.0, 0.0, 1.0) * _room.width();
    }
    double yOf(double value) const {
        const double share = (_axis.most - value) / (_axis.most - _axis.least);
        return _room.top + std::clamp(share, 0.0, 1.0) * (_room.bottom - _room.top);
    }
    void stroke(double x1, double y1, double x2, double y2) const {
        cairo_move_to(_to, x1, y1);
        cairo_line_to(_to, x2, y2);
        cairo_stroke(_to);
    }
    /// Its middle is at (x, y), moved by half its width times `side`: -1 is left of x.
    void write(const std::string& text, double x, double y, double side) const {
        const auto layout = layoutOf(_widget, text);
        TextExtent extent;
        pango_layout_get_pixel_size(layout.get(), &extent.width, &extent.height);
        cairo_move_to(_to, x + (side - 1) * extent.width / 2.0, y - extent.height / 2.0);
        pango_cairo_show_layout(_to, layout.get());
    }

    void drawValueAxis() const {
        cairo_set_line_width(_to, 1);
        for (const double label : _axis.labels) {
            setTextColor(_to, _widget, kGridPale);
            stroke(_room.left, yOf(label), _room.right, yOf(label));
            setTextColor(_to, _widget, kPaleInk);
            write(_axis.textOf(label), _room.left - kPlotBorder, yOf(label), -1);
        }
    }

    void drawTimeAxis() const {
        const TextExtent letter = extentOf(_widget, "0");
        const double y = _room.bottom + kPlotBorder / 2 + letter.height / 2.0;
        setTextColor(_to, _widget, kPaleInk);
        write(_content.unit, _room.left - kPlotBorder, y, -1);
        const int columns = static_cast<int>(_room.width() / std::max(letter.width, 1));
        for (const TimeLabel& label :
             timeLabels(_content.from, _content.to, _content.ahead, columns)) {
            const double half = extentOf(_widget, label.text).width / 2.0;
            const double x = xOf(label.time);
            if (x - half >= _room.left && x + half <= _room.right) {
                write(label.text, x, y, 0);
            }
        }
    }

    void drawEvents() const {
        setTextColor(_to, _widget, kPaleInk);
        cairo_set_line_width(_to, 2);
        for (const CurveEvent& event : _content.events) {
            stroke(xOf(event.time), _room.bottom - kEventHeight, xOf(event.time), _room.bottom);
        }
    }

    /// A line from point to point, which ends where nothing came for long; a point that stands for
    /// several numbers is as high as they are apart.
    void drawLine(const CurvePlot::Line& line) const {
        cairo_save(_to);
        setCurveInk(_to, _widget, line.number);
        cairo_set_line_cap(_to, CAIRO_LINE_CAP_ROUND);
        std::optional<Time> before;
        for (const CurvePoint& point : line.curve.points) {
            const bool isGap = !before || point.time - *before > line.curve.gap;
            const double x = xOf(point.time);
            (isGap ? cairo_move_to : cairo_line_to)(_to, x, yOf(point.first));
            cairo_line_to(_to, x, yOf(point.least));
            cairo_line_to(_to, x, yOf(point.most));
            cairo_line_to(_to, x, yOf(point.last));
            before = point.time;
        }
        cairo_stroke(_to);
        cairo_restore(_to);
    }

    /// The mark of each curve at its end, or in the next free place below.
    void drawMarks() const {
        const double height = extentOf(_widget, "a").height;
        std::vector<double> taken;
        for (const CurvePlot::Line& line : _content.lines) {
            if (line.mark.empty() || line.curve.points.empty()) {
                continue;
            }
            double y = yOf(line.curve.points.back().last);
            while (std::any_of(taken.begin(), taken.end(),
                               [&](double each) { return std::abs(each - y) < height; })) {
                y += height / 2;
            }
            taken.push_back(y);
            setCurveColor(_to, _widget, line.number);
            write(line.mark, _room.right + kPlotBorder / 2, y, 1);
        }
    }

    void drawCursor() const {
        if (!_content.cursor) {
            return;
        }
        setTextColor(_to, _widget, kPaleInk);
        cairo_set_line_width(_to, 1);
        stroke(xOf(*_content.cursor), _room.top, xOf(*_content.cursor), _room.bottom);
        for (const CurvePlot::Line& line : _content.lines) {
            if (const CurvePoint* point = pointAt(line.curve, *_content.cursor)) {
                setCurveColor(_to, _widget, line.number);
                constexpr double kWhole = 6.283185307179586;
                cairo_arc(_to, xOf(*_content.cursor), yOf(point->last), kPointRadius, 0, kWhole);
                cairo_fill(_to);
            }
        }
    }

    cairo_t* _to;
    GtkWidget* _widget;
    const CurvePlot::Content& _content;
    const ValueAxis& _axis;
    PlotRoom _room;
};

int labelCount(GtkWidget* widget, int height) {
    constexpr int kLinesPerLabel = 2;
    return height / std::max(kLinesPerLabel * extentOf(widget, "0").height, 1);
}

} // namespace

CurvePlot::CurvePlot(const Guard& guard, Pointed pointed)
    : _pointed(std::move(pointed)),
      _area(owned(GTK_DRAWING_AREA(g_object_new(GTK_TYPE_DRAWING_AREA, "accessible-role",
                                                GTK_ACCESSIBLE_ROLE_IMG, nullptr)))) {
    gtk_drawing_area_set_content_height(_area.get(), kPlotHeight);
    gtk_drawing_area_set_draw_func(
        _area.get(),
        +[](GtkDrawingArea* /*area*/, cairo_t* to, int width, int height, gpointer plot) {
            static_cast<const CurvePlot*>(plot)->draw(to, width, height);
        },
        this, nullptr);
    gtk_widget_set_focusable(widget(), TRUE); // so that screen readers get there
    gtk_widget_add_css_class(widget(), "card");
    gtk_widget_add_css_class(widget(), "pallax-plot");
    listen(guard);
}

void CurvePlot::listen(const Guard& guard) {
    GtkEventController* motion = gtk_event_controller_motion_new();
    const auto entered = [this](double x, double y) { _pointer = {x, y}; };
    const auto moved = [this](double x, double y) {
        // The toolkit tells it again when something is drawn below a pointer that rests.
        if (std::exchange(_pointer, std::pair(x, y)) != std::pair(x, y)) {
            point(x, true);
        }
    };
    connect(motion, "enter", guard, std::function<void(double, double)>(entered));
    connect(motion, "motion", guard, std::function<void(double, double)>(moved));
    onSignal(motion, "leave", guard, [this] {
        if (std::exchange(_isHovering, false)) {
            _pointed(std::nullopt);
        }
    });
    gtk_widget_add_controller(widget(), motion);
    GtkGesture* click = gtk_gesture_click_new(); // a finger, too
    connect(click, "pressed", guard,
            std::function<void(int, double, double)>(
                [this](int, double x, double) { point(x, false); }));
    gtk_widget_add_controller(widget(), GTK_EVENT_CONTROLLER(click));
}

void CurvePlot::point(double x, bool isHovering) {
    _isHovering = isHovering;
    const PlotRoom room = roomIn(widget(), std::max(labelWidth(), _leastLabelWidth), _content,
                                 gtk_widget_get_width(widget()), gtk_widget_get_height(widget()));
    const double share = std::clamp((x - room.left) / room.width(), 0.0, 1.0);
    const auto span = std::chrono::duration<double, std::nano>(_content.to - _content.from);
    _pointed(_content.from + std::chrono::round<std::chrono::nanoseconds>(span * share));
}

void CurvePlot::show(Content content, const std::string& description) {
    _content = std::move(content);
    if (description != _description) {
        _description = description;
        gtk_accessible_update_property(GTK_ACCESSIBLE(widget()), GTK_ACCESSIBLE_PROPERTY_LABEL,
                                       shownText(description).c_str(), -1);
    }
    gtk_widget_queue_draw(widget());
}

int CurvePlot::labelWidth() const {
    int width = extentOf(widget(), _content.unit).width;
    const ValueAxis axis = axisOf(_content, labelCount(widget(), kPlotHeight));
    for (const double label : axis.labels) {
        width = std::max(width, extentOf(widget(), axis.textOf(label)).width);
    }
    return width;
}

void CurvePlot::setLabelWidth(int least) {
    _leastLabelWidth = least;
    gtk_widget_queue_draw(widget());
}

void CurvePlot::draw(cairo_t* to, int width, int height) const {
    const PlotRoom room =
        roomIn(widget(), std::max(labelWidth(), _leastLabelWidth), _content, width, height);
    const ValueAxis axis = axisOf(_content, labelCount(widget(), kPlotHeight));
    if (room.right > room.left && room.bottom > room.top) {
        PlotDrawing(to, widget(), _content, axis, room).draw();
    }
}

GtkWidget* curveSwatch(std::size_t number) {
    GtkWidget* swatch = gtk_drawing_area_new();
    gtk_drawing_area_set_content_width(GTK_DRAWING_AREA(swatch), kSwatchWidth);
    gtk_drawing_area_set_content_height(GTK_DRAWING_AREA(swatch), kSwatchHeight);
    gtk_widget_set_valign(swatch, GTK_ALIGN_CENTER);
    gtk_drawing_area_set_draw_func(
        GTK_DRAWING_AREA(swatch),
        +[](GtkDrawingArea* area, cairo_t* to, int width, int height, gpointer curve) {
            setCurveInk(to, GTK_WIDGET(area), GPOINTER_TO_SIZE(curve));
            cairo_move_to(to, 0, height / 2.0);
            cairo_line_to(to, width, height / 2.0);
            cairo_stroke(to);
        },
        GSIZE_TO_POINTER(number), nullptr);
    return swatch;
}

} // namespace pallax::gtk
