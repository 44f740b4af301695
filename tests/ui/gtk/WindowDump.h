#pragma once

#include <gtk/gtk.h>
#include <string>

namespace pallax::gtk {

/// What is seen in a window, as text, after an empty line. A line for each widget with a text, and
/// for each row what it shows and where its labels stand: "name" at the left edge of the content
/// plus 10, the value flush right or behind the name, how far the row can be scrolled. Rows out of
/// view are left out. Of a table, a line has the columns and one each row the cells that are at
/// least partly seen. Nothing in it depends on the fonts.
std::string windowDump(GtkWidget* window);

} // namespace pallax::gtk
