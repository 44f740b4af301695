#include "ui/gtk/ColumnStrip.h"

#include <algorithm>
#include <cmath>

namespace pallax::gtk {

namespace {

constexpr const char* kStrip = "pallax-strip";

int pushedBy(GtkAdjustment* sideways) {
    return static_cast<int>(std::lround(gtk_adjustment_get_value(sideways)));
}

void measureNothing(GtkWidget* /*widget*/, GtkOrientation /*orientation*/, int /*across*/,
                    int* least, int* natural, int* leastBaseline, int* naturalBaseline) {
    *least = *natural = 0;
    *leastBaseline = *naturalBaseline = -1;
}

void place(GtkWidget* widget, int x, int width, int height) {
    int least = 0; // a widget must be measured before it gets its place
    gtk_widget_measure(widget, GTK_ORIENTATION_HORIZONTAL, -1, &least, nullptr, nullptr, nullptr);
    const GtkAllocation area{x, 0, std::max(width, least), height};
    gtk_widget_size_allocate(widget, &area, -1);
}

void removeChildren(GtkWidget* box) {
    while (GtkWidget* child = gtk_widget_get_first_child(box)) {
        gtk_box_remove(GTK_BOX(box), child);
    }
}

} // namespace

ColumnStrip* ColumnStrip::stripOf(GtkWidget* widget) {
    return static_cast<ColumnStrip*>(g_object_get_data(G_OBJECT(widget), kStrip));
}

Ref<GtkWidget> ColumnStrip::box(GtkCustomMeasureFunc measure, GtkCustomAllocateFunc allocate) {
    Ref<GtkWidget> made = owned(gtk_box_new(GTK_ORIENTATION_HORIZONTAL, 0));
    gtk_widget_set_layout_manager(made.get(), gtk_custom_layout_new(nullptr, measure, allocate));
    gtk_widget_set_overflow(made.get(), GTK_OVERFLOW_HIDDEN);
    return made;
}

ColumnStrip::ColumnStrip(Kind kind, GtkAdjustment* sideways) : _kind(kind), _sideways(sideways) {
    const auto measure = +[](GtkWidget* widget, GtkOrientation orientation, int /*across*/,
                             int* least, int* natural, int* leastBaseline, int* naturalBaseline) {
        const ColumnStrip* strip = stripOf(widget);
        const bool isWide = strip != nullptr && strip->_kind == Kind::Row &&
                            orientation == GTK_ORIENTATION_HORIZONTAL;
        *least = *natural = isWide ? strip->_plan.width() : 0;
        *leastBaseline = *naturalBaseline = -1;
    };
    const auto placeParts = +[](GtkWidget* widget, int width, int height, int /*baseline*/) {
        if (const ColumnStrip* strip = stripOf(widget)) {
            strip->placeParts(width, height);
        }
    };
    const auto placeCells = +[](GtkWidget* widget, int /*width*/, int height, int /*baseline*/) {
        if (const ColumnStrip* strip = stripOf(widget)) {
            strip->placeCells(widget, height);
        }
    };
    _outer = box(measure, placeParts);
    for (GtkWidget** part : {&_fixed, &_pushed}) {
        const Ref<GtkWidget> made = box(measureNothing, placeCells);
        *part = made.get();
        gtk_box_append(GTK_BOX(_outer.get()), made.get());
    }
    for (GtkWidget* each : {_outer.get(), _fixed, _pushed}) {
        g_object_set_data(G_OBJECT(each), kStrip, this);
    }
}

/// A list may keep the widgets for a while.
ColumnStrip::~ColumnStrip() {
    for (GtkWidget* each : {_outer.get(), _fixed, _pushed}) {
        g_object_set_data(G_OBJECT(each), kStrip, nullptr);
    }
}

void ColumnStrip::setCells(const ColumnPlan& plan, const std::vector<GtkWidget*>& cells) {
    removeChildren(_fixed);
    removeChildren(_pushed);
    _plan = plan;
    _cells = cells;
    for (std::size_t index = 0; index < cells.size(); ++index) {
        gtk_box_append(GTK_BOX(index < plan.fixed ? _fixed : _pushed), cells[index]);
    }
    gtk_widget_queue_resize(widget());
}

void ColumnStrip::move() {
    gtk_widget_queue_allocate(_outer.get());
    gtk_widget_queue_allocate(_pushed);
}

/// A row is itself moved to the left by the list, so that its parts go as far to the right.
void ColumnStrip::placeParts(int width, int height) const {
    const int left = _kind == Kind::Row ? pushedBy(_sideways) : 0;
    const int seen =
        _kind == Kind::Row ? static_cast<int>(gtk_adjustment_get_page_size(_sideways)) : width;
    const int fixed = _plan.fixedWidth();
    place(_fixed, left, fixed, height);
    place(_pushed, left + fixed, std::max(seen - fixed, 0), height);
}

void ColumnStrip::placeCells(GtkWidget* part, int height) const {
    const bool isFixed = part == _fixed;
    int x = isFixed ? 0 : -pushedBy(_sideways);
    const std::size_t past = isFixed ? _plan.fixed : _cells.size();
    for (std::size_t index = isFixed ? 0 : _plan.fixed; index < past; ++index) {
        place(_cells[index], x, _plan.places[index].width, height);
        x += _plan.places[index].width;
    }
}

} // namespace pallax::gtk
