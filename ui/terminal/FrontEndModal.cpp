#include "ui/terminal/FrontEnd.h"

// Keys for what lies over the panes and waits for an answer.

namespace pallax::terminal {

void FrontEnd::handleAlert(const KeyEvent& event) {
    const bool closes =
        event.key == Key::Enter || event.key == Key::Escape || event.key == Key::Click ||
        (event.key == Key::Character && (event.character == U' ' || event.character == U'q'));
    if (closes) {
        _toolkit.closeAlert();
    }
}

void FrontEnd::handleModal(ui::ModalScreen& screen, const KeyEvent& event) {
    TerminalTextField& field = terminalTextField(screen.field());
    if (event.key == Key::Escape) {
        if (field.isEditing() && !field.text().empty()) {
            field.resignFirstResponder(); // so one key does not discard the typed text
        } else {
            screen.cancelPressed();
        }
        return;
    }
    if (event.key == Key::PageUp || event.key == Key::PageDown) {
        TerminalTable& list = terminalTable(screen.list());
        list.scroll(event.key == Key::PageUp ? -list.page() : list.page());
        return;
    }
    const bool forwards = event.key == Key::Tab || event.key == Key::Down;
    const bool backwards = event.key == Key::BackTab || event.key == Key::Up;
    if (field.isEditing()) {
        if (forwards || backwards) {
            _modalFocus = forwards ? ModalFocus::Save : ModalFocus::Cancel;
            field.resignFirstResponder();
        } else if (field.handle(event) && !field.isEditing()) {
            _modalFocus = ModalFocus::Save; // after the return key
        }
        return;
    }
    if (event.key == Key::Enter || (event.key == Key::Character && event.character == U' ')) {
        _modalFocus == ModalFocus::Save ? screen.savePressed() : screen.cancelPressed();
        return;
    }
    if (event.key == Key::Character && event.character == U'?') {
        _help.open(HelpPlace::Save);
        return needsDisplay();
    }
    const bool isSave = _modalFocus == ModalFocus::Save;
    if ((forwards && !isSave) || (backwards && isSave)) {
        field.beginEditing();
    } else if (forwards || backwards || event.key == Key::Left || event.key == Key::Right) {
        _modalFocus = isSave ? ModalFocus::Cancel : ModalFocus::Save;
        needsDisplay();
    }
}

} // namespace pallax::terminal
