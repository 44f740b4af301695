#include "ui/gtk/Messages.h"

#include "ui/gtk/ShownText.h"

#include <chrono>

namespace pallax::gtk {

namespace {

constexpr int kWidth = 28;                 // characters of a line: what a phone has room for
constexpr std::chrono::seconds kLength{3}; // it covers the last rows

} // namespace

Messages::Place::Place()
    : overlay(owned(GTK_OVERLAY(gtk_overlay_new()))),
      label(GTK_WIDGET(g_object_new(GTK_TYPE_LABEL, "accessible-role", GTK_ACCESSIBLE_ROLE_STATUS,
                                    "visible", FALSE, nullptr))) {
    gtk_label_set_wrap(GTK_LABEL(label), TRUE);
    gtk_label_set_wrap_mode(GTK_LABEL(label), PANGO_WRAP_WORD_CHAR); // a file's name has no spaces
    gtk_label_set_max_width_chars(GTK_LABEL(label), kWidth);
    gtk_widget_set_halign(label, GTK_ALIGN_CENTER);
    gtk_widget_set_valign(label, GTK_ALIGN_END);
    gtk_widget_set_can_target(label, FALSE); // what it covers can be pressed
    for (const char* style : {"heading", "pallax-message"}) {
        gtk_widget_add_css_class(label, style);
    }
    gtk_overlay_add_overlay(overlay.get(), label);
}

Messages::Messages(const Guard& guard) : _guard(guard) {
    for (const char* signal : {"map", "unmap"}) { // later: the panes are not there yet, or still
        onSignal(_panes.overlay.get(), signal, guard,
                 [guard = _guard, alive = std::weak_ptr<Messages*>(_alive)] {
                     guard.queue().async([alive] {
                         if (const auto self = alive.lock()) {
                             (*self)->showAtPlace();
                         }
                     });
                 });
    }
}

void Messages::show(const std::string& text) {
    for (const Place* each : {&_window, &_panes}) {
        gtk_label_set_text(GTK_LABEL(each->label), shownText(text).c_str());
    }
    _isShowing = true;
    showAtPlace();
    _guard.queue().after(kLength, [alive = std::weak_ptr<Messages*>(_alive), number = ++_shown] {
        const auto self = alive.lock();
        if (self && (*self)->_shown == number) {
            (*self)->_isShowing = false;
            (*self)->showAtPlace();
        }
    });
}

/// One of the two, for screen readers would tell both.
void Messages::showAtPlace() {
    const bool arePanesSeen = gtk_widget_get_mapped(GTK_WIDGET(panes())) != FALSE;
    gtk_widget_set_visible(_panes.label, _isShowing && arePanesSeen ? TRUE : FALSE);
    gtk_widget_set_visible(_window.label, _isShowing && !arePanesSeen ? TRUE : FALSE);
}

} // namespace pallax::gtk
