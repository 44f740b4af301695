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
    /// Comes before the screen's own viewWillAppear.
    virtual void navigationControllerWillShow(NavigationStack& stack, TableScreen& screen,
                                              bool animated) = 0;
};

/// Screens on top of each other, the first being the root; the topmost is seen, unless a modal
/// screen lies over it.
class NavigationStack {
public:
    virtual ~NavigationStack() = default;
    virtual void setDelegate(NavigationDelegate* delegate) = 0;
    virtual const std::vector<std::shared_ptr<TableScreen>>& screens() const = 0;
    virtual void push(std::shared_ptr<TableScreen> screen, bool animated) = 0;
    /// Takes off every screen above `index`.
    virtual void popTo(std::size_t index, bool animated) = 0;
    virtual void showToolbar() = 0;
    virtual void presentModal(std::shared_ptr<ModalScreen> screen, bool animated) = 0;
    virtual void dismissModal(bool animated) = 0;
};

} // namespace pallax::ui
