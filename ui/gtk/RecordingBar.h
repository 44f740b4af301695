#pragma once

#include "ui/gtk/Ref.h"
#include "ui/gtk/Signals.h"

#include <chrono>
#include <cstdint>
#include <functional>
#include <gtk/gtk.h>
#include <string>

namespace pallax::gtk {

/// The bar of a recording that is being made: what is in it so far, and the button that ends it.
class RecordingBar {
public:
    struct State {
        std::string file; ///< its name
        std::uint64_t packets = 0;
        std::uint64_t bytes = 0; ///< of the packets
        std::chrono::seconds time{0};
    };

    /// Not seen until a state is shown.
    RecordingBar(const Guard& guard, std::function<void()> stop);
    RecordingBar(const RecordingBar&) = delete;
    RecordingBar& operator=(const RecordingBar&) = delete;

    void show(const State& state);
    void hide();
    GtkWidget* widget() const { return GTK_WIDGET(_box.get()); }

private:
    Ref<GtkBox> _box;
    GtkLabel* _file; ///< the box owns it and what follows
    GtkLabel* _amounts;
};

} // namespace pallax::gtk
