#pragma once

#include <cstddef>
#include <gtk/gtk.h>

namespace pallax::gtk {

/// Lets the curve with this number be drawn in its colour and dashes, which tell it from others
/// where colours look alike.
void setCurveInk(cairo_t* to, GtkWidget* widget, std::size_t number);
/// The same without dashes.
void setCurveColor(cairo_t* to, GtkWidget* widget, std::size_t number);
/// The colour of the text, so transparent.
void setTextColor(cairo_t* to, GtkWidget* widget, double opacity);

} // namespace pallax::gtk
