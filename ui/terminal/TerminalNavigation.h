#pragma once

#include "platform/ui/ModalScreen.h"
#include "platform/ui/NavigationStack.h"

#include <functional>

namespace pallax::terminal {

/// The stack of panes, and the modal screen above it. It tells the screens when they appear and
/// disappear; animation is ignored.
class TerminalNavigation final : public ui::NavigationStack {
public:
    TerminalNavigation(std::shared_ptr<ui::TableScreen> root, std::function<void()> needsDisplay);

    void setDelegate(ui::NavigationDelegate* delegate) override { _delegate = delegate; }
    const std::vector<std::shared_ptr<ui::TableScreen>>& screens() const override {
        return _screens;
    }
    void push(std::shared_ptr<ui::TableScreen> screen, bool animated) override;
    void popTo(std::size_t index, bool animated) override;
    void showToolbar() override;
    void presentModal(std::shared_ptr<ui::ModalScreen> screen, bool animated) override;
    void dismissModal(bool animated) override;

    /// The root is about to appear for the first time.
    void appear();
    ui::TableScreen& top() const { return *_screens.back(); }
    bool isAtRoot() const { return _screens.size() == 1; }
    /// One pane back; does nothing at the root.
    void back();
    bool isToolbarShown() const { return _isToolbarShown; }
    /// The modal screen that is open, or null.
    const std::shared_ptr<ui::ModalScreen>& modal() const { return _modal; }

private:
    void show(ui::TableScreen& screen, bool animated);

    std::vector<std::shared_ptr<ui::TableScreen>> _screens; // never empty
    std::function<void()> _needsDisplay;
    ui::NavigationDelegate* _delegate = nullptr;
    std::shared_ptr<ui::ModalScreen> _modal;
    bool _isToolbarShown = false;
};

} // namespace pallax::terminal
