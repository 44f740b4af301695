#pragma once

#include "timeline/Curve.h"
#include "ui/gtk/Ref.h"

#include <chrono>
#include <gtk/gtk.h>
#include <optional>
#include <string>
#include <vector>

namespace pallax::gtk {

/// The page of a value: what is known about it, and its curve.
class ValueView {
public:
    struct Content {
        std::string text;               ///< "-92.25 dBm"
        std::string quality;            ///< "fair"; empty if it is not judged
        std::vector<std::string> lines; ///< what is known about it
        std::optional<Curve> curve = {};
        Time from = {}; ///< of the curve
        Time to = {};
        std::chrono::seconds ahead{0}; ///< local time minus UTC
        std::string unit;
    };

    ValueView();
    ValueView(const ValueView&) = delete;
    ValueView& operator=(const ValueView&) = delete;

    void show(Content content);
    GtkWidget* widget() const { return GTK_WIDGET(_scroller.get()); }

private:
    struct Extent {
        double least;
        double most;
    };

    std::optional<Extent> extent() const;
    std::string rangeWords() const;
    void draw(cairo_t* to, double width, double height) const;

    Content _content;
    Ref<GtkScrolledWindow> _scroller;
    GtkLabel* _text; // the scroller owns it and what follows
    GtkLabel* _quality;
    GtkLabel* _facts;
    GtkDrawingArea* _curve;
    GtkLabel* _range;
};

} // namespace pallax::gtk
