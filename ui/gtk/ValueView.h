#pragma once

#include "ui/gtk/CurvePlot.h"
#include "ui/gtk/Ref.h"
#include "ui/gtk/Signals.h"
#include "ui/gtk/SpanChooser.h"

#include <cstddef>
#include <functional>
#include <gtk/gtk.h>
#include <optional>
#include <string>
#include <vector>

namespace pallax::gtk {

/// The page of a value: what is known about it, and its curve. Its texts change in place, so that
/// the page keeps its place while time goes on.
class ValueView {
public:
    struct Actions {
        std::function<void(std::size_t span)> chooseSpan;
        CurvePlot::Pointed pointed;
        std::function<void()> toggleInGraph;
        std::function<void()> openGraph;
    };
    struct Content {
        std::string text;               ///< "-92.25 dBm"
        std::string quality;            ///< "fair, 2 s old"; empty: nothing is known
        std::vector<std::string> lines; ///< what is known about it
        std::size_t span = 0;           ///< among curveSpans
        std::optional<CurvePlot::Content> plot = {};
        std::string statistics = {}; ///< of the curve
        std::string last = {};       ///< its last value; empty: it has no points
        std::string cursor = {};     ///< what the cursor is on; empty: there is none
        bool isInGraph = false;
    };

    ValueView(const Guard& guard, Actions actions);
    ValueView(const ValueView&) = delete;
    ValueView& operator=(const ValueView&) = delete;

    void show(Content content);
    GtkWidget* widget() const { return GTK_WIDGET(_scroller.get()); }

private:
    void buildCurve(const Guard& guard, GtkBox* to);

    Actions _actions;
    CurvePlot _plot;
    SpanChooser _spans;
    Ref<GtkScrolledWindow> _scroller;
    GtkLabel* _text; // the scroller owns it and what follows
    GtkLabel* _quality;
    GtkLabel* _facts;
    GtkBox* _curve;
    GtkLabel* _cursor;
    GtkLabel* _statistics;
    GtkButton* _graph;
};

} // namespace pallax::gtk
