#include "ui/gtk/Messages.h"

#include "ui/gtk/ShownText.h"

namespace pallax::gtk {

namespace {

constexpr int kWidth = 28;    // characters of a line: what a phone has room for
constexpr guint kSeconds = 3; // it covers the last rows

GtkWidget* titleOf(const std::string& text) {
    GtkWidget* label = gtk_label_new(shownText(text).c_str());
    gtk_label_set_wrap(GTK_LABEL(label), TRUE); // a toast's own would be cut on a phone
    gtk_label_set_wrap_mode(GTK_LABEL(label), PANGO_WRAP_WORD_CHAR); // a file's name has no spaces
    gtk_label_set_max_width_chars(GTK_LABEL(label), kWidth);
    gtk_widget_add_css_class(label, "heading");
    return label;
}

} // namespace

Messages::Messages(const Guard& guard)
    : _guard(guard), _window(owned(ADW_TOAST_OVERLAY(adw_toast_overlay_new()))),
      _panes(owned(ADW_TOAST_OVERLAY(adw_toast_overlay_new()))) {
    for (const char* signal : {"map", "unmap"}) { // later: the panes are not there yet, or still
        onSignal(_panes.get(), signal, guard,
                 [guard = _guard, alive = std::weak_ptr<Messages*>(_alive)] {
                     guard.queue().async([alive] {
                         if (const auto self = alive.lock()) {
                             (*self)->move();
                         }
                     });
                 });
    }
}

void Messages::show(const std::string& text) {
    if (const Ref<AdwToast> before = std::move(_toast)) {
        adw_toast_dismiss(before.get()); // it would be shown for its time before the next one
    }
    _text = text;
    _toast = shared(adw_toast_new(""));
    adw_toast_set_timeout(_toast.get(), kSeconds);
    adw_toast_set_custom_title(_toast.get(), titleOf(text));
    onSignal(_toast.get(), "dismissed", _guard,
             [alive = std::weak_ptr<Messages*>(_alive), toast = _toast.get()] {
                 const auto self = alive.lock();
                 if (self && (*self)->_toast.get() == toast) {
                     (*self)->_toast = nullptr;
                 }
             });
    _place = wantedPlace();
    adw_toast_overlay_add_toast(_place, _toast.get());
}

AdwToastOverlay* Messages::wantedPlace() const {
    return gtk_widget_get_mapped(GTK_WIDGET(_panes.get())) != FALSE ? _panes.get() : _window.get();
}

void Messages::move() {
    if (_toast && _place != wantedPlace()) {
        show(_text);
    }
}

} // namespace pallax::gtk
