#include "ui/terminal/ModalKeys.h"

#include "ui/terminal/TerminalTable.h"
#include "ui/terminal/TerminalTextField.h"

namespace pallax::terminal {

namespace {

bool goesForwards(const KeyEvent& event) {
    return event.key == Key::Tab || event.key == Key::Down;
}

bool goesBackwards(const KeyEvent& event) {
    return event.key == Key::BackTab || event.key == Key::Up;
}

} // namespace

void ModalKeys::handle(ui::ModalScreen& screen, const KeyEvent& event) {
    TerminalTextField& field = terminalTextField(screen.field());
    if (event.key == Key::Escape) {
        if (field.isEditing() && !field.text().empty()) {
            field.resignFirstResponder(); // so one key does not discard the typed text
        } else {
            screen.cancelPressed();
        }
    } else if (event.key == Key::PageUp || event.key == Key::PageDown) {
        TerminalTable& list = terminalTable(screen.list());
        list.scroll(event.key == Key::PageUp ? -list.page() : list.page());
    } else if (!field.isEditing()) {
        handleButtons(screen, event);
    } else if (goesForwards(event) || goesBackwards(event)) {
        _focus = goesForwards(event) ? ModalFocus::Save : ModalFocus::Cancel;
        field.resignFirstResponder();
    } else if (field.handle(event) && !field.isEditing()) {
        _focus = ModalFocus::Save; // after the return key
    }
}

void ModalKeys::handleButtons(ui::ModalScreen& screen, const KeyEvent& event) {
    const bool isSave = _focus == ModalFocus::Save;
    if (event.key == Key::Enter || (event.key == Key::Character && event.character == U' ')) {
        isSave ? screen.savePressed() : screen.cancelPressed();
    } else if (event.key == Key::Character && event.character == U'?') {
        _openHelp();
    } else if ((goesForwards(event) && !isSave) || (goesBackwards(event) && isSave)) {
        terminalTextField(screen.field()).beginEditing();
    } else if (goesForwards(event) || goesBackwards(event) || event.key == Key::Left ||
               event.key == Key::Right) {
        _focus = isSave ? ModalFocus::Cancel : ModalFocus::Save;
        _needsDisplay();
    }
}

} // namespace pallax::terminal
