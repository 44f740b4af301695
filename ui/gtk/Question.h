#pragma once

#include "ui/gtk/Signals.h"

#include <functional>
#include <gtk/gtk.h>
#include <string>

namespace pallax::gtk {

struct Question {
    std::string title;
    std::string text;
    const char* no; ///< what the button does that changes nothing; so does Escape
    const char* yes;
};

/// Asks over the window, and calls `agreed` if the answer is yes. The dialog, which goes with the
/// window, is returned.
GtkWindow* ask(GtkWindow* window, const Guard& guard, const Question& question,
               const std::function<void()>& agreed);

} // namespace pallax::gtk
