#pragma once

#include "ui/gtk/Ref.h"
#include "ui/gtk/Signals.h"

#include <cstdint>
#include <gtk/gtk.h>
#include <memory>
#include <string>

namespace pallax::gtk {

/// Sentences about what has just happened, each for some seconds or until the next one. They cover
/// the lower end of the panes and nothing below them or, while a page covers the panes, its end.
///
/// They are labels and not the toolkit's toasts: when these come in quick succession, as they do
/// while a key is held, libadwaita 1.2 crashes (in adw_animation_skip).
class Messages {
public:
    explicit Messages(const Guard& guard);
    Messages(const Messages&) = delete;
    Messages& operator=(const Messages&) = delete;

    void show(const std::string& text);
    /// What is around everything, and around the panes.
    GtkOverlay* window() const { return _window.overlay.get(); }
    GtkOverlay* panes() const { return _panes.overlay.get(); }

private:
    struct Place {
        Place();
        Ref<GtkOverlay> overlay;
        GtkWidget* label; ///< the overlay owns it
    };

    /// Shows the label at the place that is visible.
    void showAtPlace();

    Guard _guard;
    Place _window;
    Place _panes;
    std::uint64_t _shown = 0; ///< so many
    bool _isShowing = false;
    std::shared_ptr<Messages*> _alive = std::make_shared<Messages*>(this);
};

} // namespace pallax::gtk
