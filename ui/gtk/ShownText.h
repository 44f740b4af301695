#pragma once

#include <gtk/gtk.h>
#include <string>
#include <string_view>

/// Texts from a modem, a SIM or a file name, in widgets.
namespace pallax::gtk {

/// What a widget shows of a text: never a character that turns the direction of the text around it.
std::string shownText(std::string_view text);
/// The same for a text of several lines.
std::string shownLines(std::string_view text);
/// The same for a widget that takes markup.
std::string shownMarkup(std::string_view text);

/// Shows the text; a label without one is not seen.
void showText(GtkLabel* label, std::string_view text);

/// A tooltip, or none if the text is empty. One that stays is not set again: for that the toolkit
/// would ask the X server where the pointer is, five times and waiting for each answer.
void showTooltip(GtkWidget* widget, std::string_view text);

/// Gives a widget without a text a name, for screen readers and as a tooltip.
void nameWidget(GtkWidget* widget, const char* name);

/// Whether anybody can see it: it is on a page that is shown, of a window that is not minimized.
bool isSeen(GtkWidget* widget);

} // namespace pallax::gtk
