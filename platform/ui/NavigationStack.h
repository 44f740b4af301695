#pragma once

#include "platform/ui/TableScreen.h"

#include <cstddef>
#include <memory>
#include <vector>

namespace pallax::ui {

class ModalScreen;
class NavigationStack;

class NavigationDelegate {
public:
    virtual ~NavigationDelegate() = default;
    /// Comes before the screen's own viewWillAppear, when a push or a pop brings the screen to the
    /// top. The root's first appearance, with its window, is not announced.
    virtual void navigationControllerWillShow(NavigationStack& stack, TableScreen& screen,
                                              bool animated) = 0;
};

/// Screens on top of each other, the first being the root; the topmost is seen, unless a modal
/// screen lies over it.
///
/// A push or a pop is done when the call returns, animated or not: `screens` has changed, and the
/// screens were told (the old top viewWillDisappear, then the new top viewWillAppear). Screens in
/// between hear nothing. The root is told viewWillAppear when its window becomes visible.
class NavigationStack {
public:
    virtual ~NavigationStack() = default;
    virtual void setDelegate(NavigationDelegate* delegate) = 0;
    virtual const std::vector<std::shared_ptr<TableScreen>>& screens() const = 0;
    virtual void push(std::shared_ptr<TableScreen> screen, bool animated) = 0;
    /// Takes off every screen above `index`; does nothing where there is none.
    virtual void popTo(std::size_t index, bool animated) = 0;
    virtual void showToolbar() = 0;
    /// Calls viewDidLoad and viewWillAppear of the modal screen. The screen below does not
    /// disappear: it stays visible around the modal one, and is told neither now nor when that is
    /// dismissed.
    virtual void presentModal(std::shared_ptr<ModalScreen> screen, bool animated) = 0;
    /// Calls viewWillDisappear and viewDidUnload of the modal screen; does nothing where there is
    /// none.
    virtual void dismissModal(bool animated) = 0;
};

} // namespace pallax::ui
