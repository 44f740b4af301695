#pragma once

#include "ui/drawing/Keys.h"
#include "ui/terminal/ModalView.h"

#include <functional>
#include <utility>

namespace pallax::terminal {

/// The keys of a modal screen: of its list, its text field and its buttons.
class ModalKeys {
public:
    ModalKeys(std::function<void()> needsDisplay, std::function<void()> openHelp)
        : _needsDisplay(std::move(needsDisplay)), _openHelp(std::move(openHelp)) {}

    ModalFocus focus() const { return _focus; }
    /// For the next screen to be opened.
    void reset() { _focus = ModalFocus::Save; }
    void handle(ui::ModalScreen& screen, const KeyEvent& event);

private:
    void handleButtons(ui::ModalScreen& screen, const KeyEvent& event);

    std::function<void()> _needsDisplay;
    std::function<void()> _openHelp;
    ModalFocus _focus = ModalFocus::Save;
};

} // namespace pallax::terminal
