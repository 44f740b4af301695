#pragma once

#include "ui/gtk/Ref.h"
#include "ui/gtk/Signals.h"

#include <adwaita.h>
#include <memory>
#include <string>

namespace pallax::gtk {

/// Sentences about what has just happened, each for some seconds or until the next one. They cover
/// the lower end of the panes and nothing below them or, while a page covers the panes, its end.
class Messages {
public:
    explicit Messages(const Guard& guard);
    Messages(const Messages&) = delete;
    Messages& operator=(const Messages&) = delete;

    void show(const std::string& text);
    /// What is around everything, and around the panes.
    AdwToastOverlay* window() const { return _window.get(); }
    AdwToastOverlay* panes() const { return _panes.get(); }

private:
    AdwToastOverlay* wantedPlace() const;
    /// The panes were covered, or are seen again.
    void move();

    Guard _guard;
    Ref<AdwToastOverlay> _window;
    Ref<AdwToastOverlay> _panes;
    Ref<AdwToast> _toast;              ///< the one that is seen, if there is one
    AdwToastOverlay* _place = nullptr; ///< where it is
    std::string _text;
    std::shared_ptr<Messages*> _alive = std::make_shared<Messages*>(this);
};

} // namespace pallax::gtk
