#include "ui/terminal/TerminalNavigation.h"

#include "ui/terminal/TerminalTextField.h"

#include <utility>

namespace pallax::terminal {

TerminalNavigation::TerminalNavigation(std::shared_ptr<ui::TableScreen> root,
                                       std::function<void()> needsDisplay)
    : _screens{std::move(root)}, _needsDisplay(std::move(needsDisplay)) {}

void TerminalNavigation::push(std::shared_ptr<ui::TableScreen> screen, bool animated) {
    top().viewWillDisappear(animated);
    _screens.push_back(std::move(screen));
    show(top(), animated);
}

void TerminalNavigation::popTo(std::size_t index, bool animated) {
    if (index + 1 >= _screens.size()) {
        return;
    }
    top().viewWillDisappear(animated);
    _screens.resize(index + 1);
    show(top(), animated);
}

void TerminalNavigation::showToolbar() {
    _isToolbarShown = true;
    _needsDisplay();
}

void TerminalNavigation::presentModal(std::shared_ptr<ui::ModalScreen> screen, bool animated) {
    _modal = std::move(screen);
    _modal->viewDidLoad();
    _modal->viewWillAppear(animated);
    terminalTextField(_modal->field()).beginEditing(); // the user will type next
}

void TerminalNavigation::dismissModal(bool animated) {
    if (const std::shared_ptr<ui::ModalScreen> closing = std::exchange(_modal, nullptr)) {
        closing->viewWillDisappear(animated);
        closing->viewDidUnload();
    }
    _needsDisplay();
}

void TerminalNavigation::appear() {
    top().viewWillAppear(false);
    _needsDisplay();
}

void TerminalNavigation::back() {
    if (!isAtRoot()) {
        popTo(_screens.size() - 2, true);
    }
}

void TerminalNavigation::show(ui::TableScreen& screen, bool animated) {
    if (_delegate != nullptr) {
        _delegate->navigationControllerWillShow(*this, screen, animated);
    }
    screen.viewWillAppear(animated);
    _needsDisplay();
}

} // namespace pallax::terminal
