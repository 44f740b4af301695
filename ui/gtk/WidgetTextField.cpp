#include "ui/gtk/WidgetTextField.h"

namespace pallax::gtk {

WidgetTextField::WidgetTextField(const Guard& guard) : _entry(owned(GTK_ENTRY(gtk_entry_new()))) {
    onSignal(_entry.get(), "activate", guard, [this] {
        // The toolkit has no default action for the return key.
        if (_delegate != nullptr) {
            (void)_delegate->textFieldShouldReturn(*this);
        }
    });
}

std::string WidgetTextField::text() const {
    return gtk_editable_get_text(GTK_EDITABLE(_entry.get()));
}

/// Whatever has the focus in its place, the on-screen keyboard goes away.
void WidgetTextField::resignFirstResponder() {
    if (GtkRoot* root = gtk_widget_get_root(widget())) {
        gtk_root_set_focus(root, nullptr);
    }
}

} // namespace pallax::gtk
