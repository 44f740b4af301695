#pragma once

#include "ui/gtk/Ref.h"
#include "ui/gtk/Signals.h"

#include <cstddef>
#include <functional>
#include <gtk/gtk.h>
#include <vector>

namespace pallax::gtk {

/// A row of buttons, one for each of `curveSpans`.
class SpanChooser {
public:
    SpanChooser(const Guard& guard, std::function<void(std::size_t span)> chosen);
    SpanChooser(const SpanChooser&) = delete;
    SpanChooser& operator=(const SpanChooser&) = delete;

    void show(std::size_t span);
    GtkWidget* widget() const { return GTK_WIDGET(_box.get()); }

private:
    std::function<void(std::size_t span)> _chosen;
    Ref<GtkBox> _box;
    std::vector<GtkToggleButton*> _buttons; ///< the box owns them
    bool _isShowing = false;                ///< a button is being set by us
};

} // namespace pallax::gtk
