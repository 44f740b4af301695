#include "ui/gtk/TimeBar.h"

#include "ui/gtk/ShownText.h"
#include "ui/gtk/Translation.h"

#include <utility>

namespace pallax::gtk {

namespace {

constexpr int kGap = 6;
constexpr double kFinestStep = 0.001;
constexpr std::size_t kMostMarks = 50; // more are a stripe

} // namespace

TimeBar::TimeBar(const Guard& guard, Actions actions)
    : _guard(guard), _actions(std::move(actions)),
      _box(owned(GTK_BOX(gtk_box_new(GTK_ORIENTATION_VERTICAL, 0)))),
      _scale(GTK_SCALE(gtk_scale_new_with_range(GTK_ORIENTATION_HORIZONTAL, 0, 1, kFinestStep))),
      _words(GTK_LABEL(gtk_label_new(nullptr))) {
    gtk_widget_add_css_class(widget(), "pallax-toolbar");
    nameWidget(GTK_WIDGET(_scale), translated("Time"));
    onSignal(_scale, "value-changed", guard, [this] {
        if (!_isShowing) {
            _actions.toShare(gtk_range_get_value(GTK_RANGE(_scale)));
        }
    });
    gtk_label_set_ellipsize(_words, PANGO_ELLIPSIZE_END);
    gtk_box_append(_box.get(), GTK_WIDGET(_words)); // beside the buttons is no room on a phone
    gtk_box_append(_box.get(), GTK_WIDGET(_scale));
    auto* buttons = GTK_BOX(gtk_box_new(GTK_ORIENTATION_HORIZONTAL, kGap));
    buildButtons(buttons);
    gtk_widget_set_halign(GTK_WIDGET(buttons), GTK_ALIGN_CENTER);
    gtk_box_append(_box.get(), GTK_WIDGET(buttons));
    buildPlace();
}

GtkWidget* TimeBar::addButton(GtkBox* to, const char* icon, const char* text, Wish wish) {
    GtkWidget* button = gtk_button_new_from_icon_name(icon);
    gtk_widget_add_css_class(button, "flat");
    nameWidget(button, text);
    onSignal(button, "clicked", _guard, [this, wish] { _actions.wish(wish); });
    gtk_box_append(to, button);
    return button;
}

void TimeBar::buildButtons(GtkBox* to) {
    (void)addButton(to, "media-skip-backward-symbolic", translated("Event before"),
                    Wish::EventBack);
    (void)addButton(to, "go-previous-symbolic", translated("Tick before"), Wish::TickBack);
    _hold = GTK_BUTTON(
        addButton(to, "media-playback-pause-symbolic", translated("Hold"), Wish::HoldOrPlay));
    (void)addButton(to, "go-next-symbolic", translated("Next tick"), Wish::TickForward);
    (void)addButton(to, "media-skip-forward-symbolic", translated("Next event"),
                    Wish::EventForward);
    (void)addButton(to, "go-last-symbolic", translated("To the present"), Wish::ToPresent);
}

void TimeBar::buildPlace() {
    _place = GTK_ENTRY(gtk_entry_new());
    gtk_entry_set_placeholder_text(_place, "14:03, +90s, measured_rsrp < -110");
    nameWidget(GTK_WIDGET(_place),
               translated("Go to a time, or to where a condition becomes true"));
    onSignal(_place, "activate", _guard,
             [this] { _actions.goTo(gtk_editable_get_text(GTK_EDITABLE(_place))); });
    GtkEventController* keys = gtk_event_controller_key_new();
    gtk_event_controller_set_propagation_phase(keys, GTK_PHASE_CAPTURE);
    const auto pressed = [this](guint key) -> gboolean {
        if (key == GDK_KEY_Escape) {
            leavePlace();
        }
        return key == GDK_KEY_Escape ? TRUE : FALSE;
    };
    connect(keys, "key-pressed", _guard, std::function<gboolean(guint)>(pressed));
    gtk_widget_add_controller(GTK_WIDGET(_place), keys);
    gtk_widget_set_hexpand(GTK_WIDGET(_place), TRUE);
    auto* row = GTK_BOX(gtk_box_new(GTK_ORIENTATION_HORIZONTAL, kGap));
    gtk_box_append(row, GTK_WIDGET(_place));
    (void)addButton(row, "bookmark-new-symbolic", translated("Mark"), Wish::Mark);
    _changes = addButton(row, "view-dual-symbolic", translated("Changes since the Mark"),
                         Wish::ShowChanges);
    gtk_box_append(_box.get(), GTK_WIDGET(row));
}

/// Whatever has the focus in its place, the on-screen keyboard goes away.
void TimeBar::leavePlace() {
    if (gtk_widget_get_focus_child(widget()) != nullptr) {
        gtk_root_set_focus(gtk_widget_get_root(widget()), nullptr);
    }
}

/// Events above the scale, the marked instant below it.
void TimeBar::showMarks(const State& state) {
    if (state.events == _events && state.marked == _marked) {
        return;
    }
    _events = state.events;
    _marked = state.marked;
    gtk_scale_clear_marks(_scale);
    for (std::size_t event = 0; event < _events.size() && _events.size() <= kMostMarks; ++event) {
        gtk_scale_add_mark(_scale, _events[event], GTK_POS_TOP, nullptr);
    }
    if (_marked) {
        gtk_scale_add_mark(_scale, *_marked, GTK_POS_BOTTOM, nullptr);
    }
}

void TimeBar::show(const State& state) {
    _isShowing = true;
    gtk_range_set_value(GTK_RANGE(_scale), state.share);
    _isShowing = false;
    showMarks(state);
    gtk_widget_set_sensitive(_changes, state.marked ? TRUE : FALSE);
    const bool moves = state.isPlaying || state.words.empty();
    gtk_button_set_icon_name(_hold, moves ? "media-playback-pause-symbolic"
                                          : "media-playback-start-symbolic");
    nameWidget(GTK_WIDGET(_hold), moves ? translated("Hold") : translated("Play"));
    const std::string words = state.words.empty() ? state.clock : state.clock + ", " + state.words;
    gtk_label_set_text(_words, shownText(words).c_str());
}

} // namespace pallax::gtk
