#pragma once

#include "ui/gtk/Ref.h"

#include <gtk/gtk.h>
#include <string_view>

namespace pallax::gtk {

inline constexpr int kPageBorder = 12;

/// What a page over the panes is in: it scrolls up and down.
Ref<GtkScrolledWindow> pageScroller();
/// The content of a page, from top to bottom.
GtkBox* pageBox();

/// Shows a text of one or several lines; a label without one is not seen. A text that is shown
/// already stays as it is, with what the user has selected in it.
void changeText(GtkLabel* label, std::string_view text);

} // namespace pallax::gtk
