#pragma once

#include "ui/gtk/CurvePlot.h"
#include "ui/gtk/Ref.h"
#include "ui/gtk/Signals.h"
#include "ui/gtk/SpanChooser.h"

#include <cstddef>
#include <functional>
#include <gtk/gtk.h>
#include <memory>
#include <string>
#include <vector>

namespace pallax::gtk {

/// The page of the graph: the curves of several values, one plot for each unit, below each other.
class GraphView {
public:
    struct Actions {
        std::function<void(std::size_t span)> chooseSpan;
        CurvePlot::Pointed pointed;
    };
    /// A plot, with the words of its lines: "a  -92.25 dBm  Measured RSRP".
    struct Plot {
        CurvePlot::Content content;
        std::vector<std::string> legend;
    };
    struct Content {
        std::size_t span = 0; ///< among curveSpans
        std::vector<Plot> plots;
        std::string words; ///< the time that is shown, or what the cursor is on
    };

    GraphView(const Guard& guard, Actions actions);
    GraphView(const GraphView&) = delete;
    GraphView& operator=(const GraphView&) = delete;

    void show(const Content& content);
    GtkWidget* widget() const { return GTK_WIDGET(_scroller.get()); }

private:
    struct PlotWidgets {
        std::unique_ptr<CurvePlot> plot;
        std::vector<std::size_t> numbers; ///< of its lines
        std::vector<GtkLabel*> legend;
    };

    void build(const std::vector<Plot>& plots);

    Guard _guard;
    Actions _actions;
    SpanChooser _spans;
    Ref<GtkScrolledWindow> _scroller;
    GtkBox* _plotsBox; // the scroller owns it and what follows
    GtkLabel* _words;
    std::vector<PlotWidgets> _plots;
};

} // namespace pallax::gtk
