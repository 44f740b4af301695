#pragma once

#include "platform/ui/ModalScreen.h"
#include "ui/gtk/Signals.h"
#include "ui/gtk/WidgetTextField.h"

#include <gtk/gtk.h>

namespace pallax::gtk {

/// The widgets of a modal screen: its list, its field, and the buttons. The screen must outlive
/// them.
GtkWidget* saveScreen(ui::ModalScreen& screen, const Guard& guard);

/// Every text field of this front end's screens comes from its toolkit.
WidgetTextField& widgetTextField(ui::TextField& field);

} // namespace pallax::gtk
