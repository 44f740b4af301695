#pragma once

#include "ui/gtk/Ref.h"
#include "ui/gtk/Signals.h"

#include <functional>
#include <gtk/gtk.h>
#include <string>
#include <vector>

namespace pallax::gtk {

/// The bar that goes back and forth in time.
class TimeBar {
public:
    /// What the user wants.
    enum class Wish {
        HoldOrPlay,
        TickBack,
        TickForward,
        EventBack,
        EventForward,
        ToPresent,
    };
    struct Actions {
        std::function<void(Wish)> wish;
        std::function<void(double share)> toShare; ///< from 0, the earliest, to 1, the latest
        /// A time ("14:03") or a condition that becomes true.
        std::function<void(std::string place)> goTo;
    };
    /// What is shown.
    struct State {
        std::string words; ///< "held, 12 s behind"; empty at the present
        std::string clock; ///< "22:14:06"
        double share = 1;
        bool isPlaying = false;
        std::vector<double> events = {}; ///< the shares at which something happened
    };

    TimeBar(const Guard& guard, Actions actions);
    TimeBar(const TimeBar&) = delete;
    TimeBar& operator=(const TimeBar&) = delete;

    void show(const State& state);
    GtkWidget* widget() const { return GTK_WIDGET(_box.get()); }

private:
    GtkWidget* addButton(GtkBox* to, const char* icon, const char* name, Wish wish);
    void buildButtons(GtkBox* to);
    void buildPlace();

    Guard _guard;
    Actions _actions;
    Ref<GtkBox> _box;
    GtkScale* _scale; // the box owns it and what follows
    GtkLabel* _words;
    GtkButton* _hold = nullptr;
    GtkEntry* _place = nullptr;
    std::vector<double> _events;
    bool _isShowing = false; ///< the scale is being set by us
};

} // namespace pallax::gtk
