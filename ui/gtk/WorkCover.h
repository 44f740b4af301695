#pragma once

#include "ui/gtk/Ref.h"
#include "ui/gtk/Signals.h"

#include <functional>
#include <gtk/gtk.h>
#include <string>

namespace pallax::gtk {

/// A page of a stack that tells of long work while nothing else may be done.
class WorkCover {
public:
    WorkCover() = default;
    WorkCover(const WorkCover&) = delete;
    WorkCover& operator=(const WorkCover&) = delete;

    /// Words again replace the latest; `stop` is called by a button, or by Escape. The stack must
    /// outlive the page.
    void show(GtkStack* stack, const Guard& guard, const std::string& words,
              std::function<void()> stop);
    /// Shows what was there before.
    void hide();
    bool isShown() const { return _page != nullptr; }
    /// Stops the work, if there is any.
    void stop() const;
    /// True for a key that only the cover gets; others are for its button.
    bool handleKey(guint key) const;

private:
    void build(const Guard& guard);

    GtkStack* _stack = nullptr;
    GtkWidget* _page = nullptr; ///< the stack owns it
    GtkLabel* _words = nullptr;
    Ref<GtkWidget> _before; ///< what was shown
    Ref<GtkWidget> _focus;  ///< what had the focus
    std::function<void()> _stop = [] {};
};

} // namespace pallax::gtk
