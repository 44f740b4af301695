#include "ui/terminal/ModalKeys.h"

#include "ui/terminal/TerminalTable.h"
#include "ui/terminal/TerminalTextField.h"

namespace pallax::terminal {

void handleModalKey(ui::ModalScreen& screen, ModalFocus& focus, const KeyEvent& event) {
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
            focus = forwards ? ModalFocus::Save : ModalFocus::Cancel;
            field.resignFirstResponder();
        } else if (field.handle(event) && !field.isEditing()) {
            focus = ModalFocus::Save; // after the return key
        }
        return;
    }
    if (event.key == Key::Enter || (event.key == Key::Character && event.character == U' ')) {
        focus == ModalFocus::Save ? screen.savePressed() : screen.cancelPressed();
        return;
    }
    const bool isSave = focus == ModalFocus::Save;
    if ((forwards && !isSave) || (backwards && isSave)) {
        field.beginEditing();
    } else if (forwards || backwards || event.key == Key::Left || event.key == Key::Right) {
        focus = isSave ? ModalFocus::Cancel : ModalFocus::Save;
    }
}

} // namespace pallax::terminal
