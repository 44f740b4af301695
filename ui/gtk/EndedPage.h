#pragma once

#include "ui/gtk/Signals.h"

#include <functional>
#include <gtk/gtk.h>
#include <string>

namespace pallax::gtk {

/// The page that tells why nothing comes any more. `closed` runs as a block of the guard's queue
/// when the user presses its button, which can be given the keyboard.
struct EndedPage {
    GtkWidget* widget;
    GtkWidget* button;
};
EndedPage endedPage(const std::string& sentence, const Guard& guard, std::function<void()> closed);

} // namespace pallax::gtk
