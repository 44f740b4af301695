#include "ui/gtk/WorkCover.h"

#include "ui/gtk/PageParts.h"
#include "ui/gtk/Translation.h"

#include <adwaita.h>
#include <utility>

namespace pallax::gtk {

namespace {

constexpr int kWorkSpinner = 48;

} // namespace

void WorkCover::show(GtkStack* stack, const Guard& guard, const std::string& words,
                     std::function<void()> stop) {
    _stop = std::move(stop);
    if (_page == nullptr) {
        _stack = stack;
        _before = shared(gtk_stack_get_visible_child(stack));
        GtkWidget* focus =
            gtk_root_get_focus(gtk_widget_get_root(GTK_WIDGET(stack))); // null without any
        _focus = focus != nullptr ? shared(focus) : nullptr;
        build(guard);
    }
    changeText(_words, words);
}

void WorkCover::build(const Guard& guard) {
    _page = gtk_box_new(GTK_ORIENTATION_VERTICAL, 0);
    gtk_box_append(GTK_BOX(_page), adw_header_bar_new());
    GtkWidget* content = gtk_box_new(GTK_ORIENTATION_VERTICAL, kPageBorder);
    gtk_widget_set_valign(content, GTK_ALIGN_CENTER);
    gtk_widget_set_vexpand(content, TRUE);
    GtkWidget* spinner = gtk_spinner_new();
    gtk_widget_set_size_request(spinner, kWorkSpinner, kWorkSpinner);
    gtk_spinner_start(GTK_SPINNER(spinner));
    _words = GTK_LABEL(gtk_label_new(nullptr));
    gtk_label_set_wrap(_words, TRUE);
    gtk_widget_add_css_class(GTK_WIDGET(_words), "numeric");
    GtkWidget* cancel = gtk_button_new_with_label(translated("Cancel"));
    gtk_widget_add_css_class(cancel, "pill");
    gtk_widget_set_halign(cancel, GTK_ALIGN_CENTER);
    onSignal(cancel, "clicked", guard, [this] { stop(); });
    for (GtkWidget* child : {spinner, GTK_WIDGET(_words), cancel}) {
        gtk_box_append(GTK_BOX(content), child);
    }
    gtk_box_append(GTK_BOX(_page), content);
    gtk_stack_add_child(_stack, _page);
    gtk_stack_set_visible_child(_stack, _page);
    gtk_widget_grab_focus(cancel);
}

void WorkCover::hide() {
    if (_page == nullptr) {
        return;
    }
    gtk_stack_set_visible_child(_stack, _before.get());
    gtk_stack_remove(_stack, std::exchange(_page, nullptr));
    if (_focus && gtk_widget_get_mapped(_focus.get()) != FALSE) {
        gtk_widget_grab_focus(_focus.get());
    }
    _before.reset();
    _focus.reset();
    _stop = [] {};
}

void WorkCover::stop() const {
    _stop();
}

bool WorkCover::handleKey(guint key) const {
    switch (key) {
    case GDK_KEY_Escape:
    case GDK_KEY_Back:
        stop();
        return true;
    case GDK_KEY_Tab:
    case GDK_KEY_space:
    case GDK_KEY_Return:
    case GDK_KEY_KP_Enter:
        return false;
    default:
        return true;
    }
}

} // namespace pallax::gtk
