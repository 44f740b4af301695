#include "ui/gtk/ValueView.h"

#include "overview/ValueFacts.h"
#include "text/Date.h"
#include "ui/gtk/ShownText.h"
#include "ui/gtk/Translation.h"

#include <algorithm>
#include <utility>

namespace pallax::gtk {

namespace {

constexpr int kBorder = 12;
constexpr int kCurveHeight = 220;
constexpr double kLineWidth = 2;

GtkLabel* addLabel(GtkWidget* box, const char* look) {
    GtkWidget* label = gtk_label_new(nullptr);
    gtk_label_set_xalign(GTK_LABEL(label), 0);
    gtk_label_set_wrap(GTK_LABEL(label), TRUE);
    gtk_label_set_selectable(GTK_LABEL(label), TRUE); // to copy it
    if (look != nullptr) {
        gtk_widget_add_css_class(label, look);
    }
    gtk_box_append(GTK_BOX(box), label);
    return GTK_LABEL(label);
}

} // namespace

ValueView::ValueView() : _scroller(owned(GTK_SCROLLED_WINDOW(gtk_scrolled_window_new()))) {
    gtk_scrolled_window_set_policy(_scroller.get(), GTK_POLICY_NEVER, GTK_POLICY_AUTOMATIC);
    GtkWidget* box = gtk_box_new(GTK_ORIENTATION_VERTICAL, kBorder);
    for (const auto& set : {gtk_widget_set_margin_top, gtk_widget_set_margin_bottom,
                            gtk_widget_set_margin_start, gtk_widget_set_margin_end}) {
        set(box, kBorder);
    }
    _text = addLabel(box, "title-1");
    _quality = addLabel(box, "heading");
    _curve = GTK_DRAWING_AREA(gtk_drawing_area_new());
    gtk_drawing_area_set_content_height(_curve, kCurveHeight);
    gtk_drawing_area_set_draw_func(
        _curve,
        +[](GtkDrawingArea* /*area*/, cairo_t* to, int width, int height, gpointer view) {
            static_cast<const ValueView*>(view)->draw(to, width, height);
        },
        this, nullptr);
    gtk_widget_add_css_class(GTK_WIDGET(_curve), "card");
    gtk_box_append(GTK_BOX(box), GTK_WIDGET(_curve));
    _range = addLabel(box, "dim-label");
    _facts = addLabel(box, nullptr);
    gtk_scrolled_window_set_child(_scroller.get(), box);
    gtk_widget_set_vexpand(widget(), TRUE);
}

void ValueView::show(Content content) {
    _content = std::move(content);
    showText(_text, _content.text.empty() ? translated("no value now") : _content.text);
    showText(_quality, _content.quality);
    std::string facts;
    for (const std::string& line : _content.lines) {
        facts += (facts.empty() || line.empty() ? "" : "\n") + shownText(line);
    }
    gtk_label_set_text(_facts, facts.c_str());
    const std::string range = rangeWords();
    showText(_range, range);
    gtk_widget_set_visible(GTK_WIDGET(_curve), range.empty() ? FALSE : TRUE);
    gtk_accessible_update_property(GTK_ACCESSIBLE(_curve), GTK_ACCESSIBLE_PROPERTY_LABEL,
                                   (translated("Curve: ") + shownText(range)).c_str(), -1);
    gtk_widget_queue_draw(GTK_WIDGET(_curve));
}

std::optional<ValueView::Extent> ValueView::extent() const {
    if (!_content.curve || _content.curve->points.empty()) {
        return std::nullopt;
    }
    Extent extent{_content.curve->points.front().least, _content.curve->points.front().most};
    for (const CurvePoint& point : _content.curve->points) {
        extent = {std::min(extent.least, point.least), std::max(extent.most, point.most)};
    }
    return extent;
}

/// "-101.5 to -82.25 dBm, 22:13:20 to 22:15:20".
std::string ValueView::rangeWords() const {
    const auto range = extent();
    if (!range) {
        return "";
    }
    constexpr std::size_t kTimeOfDay = 11; // in "2023-11-14 22:14:06"
    const auto clock = [this](Time time) {
        return localDateText(time, _content.ahead).substr(kTimeOfDay);
    };
    return shortNumber(range->least) + " … " + shortNumber(range->most) + " " + _content.unit +
           ", " + clock(_content.from) + " – " + clock(_content.to);
}

/// A line from point to point, which ends where nothing came for long; a point that stands for
/// several numbers is as high as they are apart.
void ValueView::draw(cairo_t* to, double width, double height) const {
    const auto range = extent();
    if (!range) {
        return;
    }
    GdkRGBA color;
    gtk_style_context_get_color(gtk_widget_get_style_context(GTK_WIDGET(_curve)), &color);
    gdk_cairo_set_source_rgba(to, &color);
    cairo_set_line_width(to, kLineWidth);
    const double from = static_cast<double>(_content.from.time_since_epoch().count());
    const double length =
        std::max(static_cast<double>(_content.to.time_since_epoch().count()) - from, 1.0);
    const double span = std::max(range->most - range->least, 1e-9);
    const auto x = [&](Time time) {
        const double share = (static_cast<double>(time.time_since_epoch().count()) - from) / length;
        return kBorder + share * (width - 2 * kBorder);
    };
    const auto y = [&](double value) {
        return height - kBorder - (value - range->least) / span * (height - 2 * kBorder);
    };
    std::optional<Time> before;
    for (const CurvePoint& point : _content.curve->points) {
        const bool isGap = !before || point.time - *before > _content.curve->gap;
        (isGap ? cairo_move_to : cairo_line_to)(to, x(point.time), y(point.first));
        cairo_line_to(to, x(point.time), y(point.least));
        cairo_line_to(to, x(point.time), y(point.most));
        cairo_line_to(to, x(point.time), y(point.last));
        before = point.time;
    }
    cairo_stroke(to);
}

} // namespace pallax::gtk
