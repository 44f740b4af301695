#pragma once

#include "ui/gtk/Ref.h"
#include "ui/gtk/Signals.h"

#include <functional>
#include <gtk/gtk.h>
#include <optional>
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
        Mark,
        ShowChanges, ///< since the mark
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
        std::optional<double> marked = {}; ///< the share of the marked instant
        std::vector<double> events = {};   ///< the shares at which something happened
    };

    TimeBar(const Guard& guard, Actions actions);
    TimeBar(const TimeBar&) = delete;
    TimeBar& operator=(const TimeBar&) = delete;

    void show(const State& state);
    /// Lets the user type a place.
    void focusPlace() { gtk_widget_grab_focus(GTK_WIDGET(_place)); }
    void clearPlace() { gtk_editable_set_text(GTK_EDITABLE(_place), ""); }
    GtkWidget* widget() const { return GTK_WIDGET(_box.get()); }

private:
    GtkWidget* addButton(GtkBox* to, const char* icon, const char* name, Wish wish);
    void buildButtons(GtkBox* to);
    void buildPlace();
    void showMarks(const State& state);
    void leavePlace();

    Guard _guard;
    Actions _actions;
    Ref<GtkBox> _box;
    GtkScale* _scale; // the box owns it and what follows
    GtkLabel* _words;
    GtkButton* _hold = nullptr;
    GtkEntry* _place = nullptr;
    GtkWidget* _changes = nullptr;
    std::vector<double> _events; ///< as they are shown, as `_marked`
    std::optional<double> _marked;
    bool _isShowing = false; ///< the scale is being set by us
};

} // namespace pallax::gtk
