#pragma once

#include "platform/ui/ModalScreen.h"
#include "ui/terminal/Keys.h"
#include "ui/terminal/ModalView.h"

namespace pallax::terminal {

/// Gives a key to a modal screen: to its text field while that is edited, else to its buttons, of
/// which one has the focus.
void handleModalKey(ui::ModalScreen& screen, ModalFocus& focus, const KeyEvent& event);

} // namespace pallax::terminal
