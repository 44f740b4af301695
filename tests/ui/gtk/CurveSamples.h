#pragma once

#include "tests/ui/gtk/WindowStage.h"
#include "ui/gtk/CurvePlot.h"

#include <chrono>
#include <optional>
#include <string>

namespace pallax::gtk {

/// Two points of a minute that begins at 00:00:10.
inline Curve sampleCurve() {
    using namespace std::chrono_literals;
    Curve curve;
    curve.points = {{Time{10s}, -94, -101.5, -90, -92}, {Time{40s}, -92, -92, -82.25, -85}};
    curve.gap = 60s;
    return curve;
}

inline CurvePlot::Content samplePlot() {
    using namespace std::chrono_literals;
    return {.from = Time{10s},
            .to = Time{70s},
            .ahead = 1h,
            .unit = "dBm",
            .lines = {{"", 0, sampleCurve()}},
            .events = {{Time{30s}, "cell change"}}};
}

/// The plots of a page, in their order.
inline std::vector<GtkWidget*> plotsBelow(GtkWidget* widget) {
    std::vector<GtkWidget*> plots;
    (void)WindowStage::found(widget, [&plots](GtkWidget* each) {
        if (gtk_widget_has_css_class(each, "pallax-plot") != FALSE) {
            plots.push_back(each);
        }
        return false;
    });
    return plots;
}

/// What a screen reader says of a plot is other than this: how; empty: it is this.
inline std::string faultOfName(GtkWidget* plot, const std::string& name) {
    char* fault = gtk_test_accessible_check_property(GTK_ACCESSIBLE(plot),
                                                     GTK_ACCESSIBLE_PROPERTY_LABEL, name.c_str());
    const std::string text = fault != nullptr ? fault : "";
    g_free(fault);
    return text;
}

/// Lets a controller of a widget tell of the pointer.
inline void point(GtkWidget* widget, GType controllerType, const char* signal, double x) {
    GListModel* controllers = gtk_widget_observe_controllers(widget);
    for (guint index = 0; index < g_list_model_get_n_items(controllers); ++index) {
        const Ref<GObject> each(G_OBJECT(g_list_model_get_item(controllers, index)));
        if (g_type_is_a(G_OBJECT_TYPE(each.get()), controllerType) == FALSE) {
            continue;
        }
        if (std::string(signal) == "pressed") {
            g_signal_emit_by_name(each.get(), signal, 1, x, 20.0);
        } else if (std::string(signal) == "leave") {
            g_signal_emit_by_name(each.get(), signal);
        } else {
            g_signal_emit_by_name(each.get(), signal, x, 20.0);
        }
    }
    g_object_unref(controllers);
}

} // namespace pallax::gtk
