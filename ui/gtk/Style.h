#pragma once

#include <gtk/gtk.h>

namespace pallax::gtk {

/// Gives the display the look of rows and bars. Only the first call does anything.
void addStyle();

/// Gives a widget a class of that look, or takes it.
void setClass(GtkWidget* widget, const char* name, bool isSet);

} // namespace pallax::gtk
