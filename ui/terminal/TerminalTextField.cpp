#include "ui/terminal/TerminalTextField.h"

namespace pallax::terminal {

TerminalTextField& terminalTextField(ui::TextField& field) {
    return static_cast<TerminalTextField&>(field);
}

void TerminalTextField::resignFirstResponder() {
    _isEditing = false;
    _needsDisplay();
}

void TerminalTextField::beginEditing() {
    _isEditing = true;
    _needsDisplay();
}

bool TerminalTextField::handle(const KeyEvent& event) {
    if (event.key == Key::Enter) {
        // The toolkit has no default action for the return key.
        if (_delegate != nullptr) {
            (void)_delegate->textFieldShouldReturn(*this);
        }
        return true;
    }
    if (!_editor.handle(event)) {
        return false;
    }
    _needsDisplay();
    return true;
}

} // namespace pallax::terminal
