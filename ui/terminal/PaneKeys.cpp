#include "ui/terminal/FrontEnd.h"

namespace pallax::terminal {

namespace {

constexpr int kScrollColumns = 8; // per key, in a row that does not fit

} // namespace

void FrontEnd::handlePane(const KeyEvent& event) {
    TerminalTable& pane = *table();
    if (moveCursor(pane, event)) {
        return;
    }
    switch (event.key) {
    case Key::Enter:
        return openRow();
    case Key::Right:
        openOrScroll(pane, true);
        return;
    case Key::Left:
        goBack(pane);
        return;
    case Key::Backspace:
        navigation()->back();
        return;
    case Key::Escape:
        escape(pane);
        return;
    case Key::Character:
        if (!handleTime(event)) {
            handlePaneCharacter(event.character);
        }
        return;
    default:
        return;
    }
}

void FrontEnd::handlePaneCharacter(char32_t character) {
    TerminalTable& pane = *table();
    switch (character) {
    case U'j':
        return pane.moveCursor(1);
    case U'k':
        return pane.moveCursor(-1);
    case U'l':
        return openOrScroll(pane, true);
    case U'h':
        return goBack(pane);
    case U'g':
        return pane.moveCursorTo(0);
    case U'G':
        return pane.moveToEnd();
    case U'/':
        return startFilter(pane);
    case U'o':
        return openOverview();
    case U'e':
        return openEvents();
    case U';':
        return openQuery();
    case U'f':
        return openSearch();
    case U'i':
    case U'v':
    case U'V':
        return handleValueKey(character);
    case U's':
        return save();
    case U'y':
        return copyValue(pane);
    case U'?':
        _help.open(_pages.isOpen() ? HelpPlace::Pages : HelpPlace::Panes);
        return needsDisplay();
    case U'R':
        return _surroundings.startAfresh();
    case U'x': // hides a column where there are columns
        return pane.list() == nullptr ? _surroundings.switchSafe() : pane.handleListKey(character);
    case U'q':
        return navigation()->isAtRoot() ? _surroundings.quit() : navigation()->back();
    case U't':
        if (!pane.isListWithColumns()) {
            return setMessage("Nothing to show as a table: choose a list.");
        }
        return pane.handleListKey(character);
    default:
        return handleNumber(character) ? void() : pane.handleListKey(character);
    }
}

bool FrontEnd::handleNumber(char32_t character) {
    const bool isNumber = character >= U'1' && character <= U'9';
    if (isNumber) {
        _surroundings.chooseModem(static_cast<std::size_t>(character - U'0'));
    }
    return isNumber;
}

bool FrontEnd::moveCursor(TerminalTable& table, const KeyEvent& event) {
    switch (event.key) {
    case Key::Up:
        table.moveCursor(-1);
        return true;
    case Key::Down:
        table.moveCursor(1);
        return true;
    case Key::PageUp:
        table.moveCursor(-table.page());
        return true;
    case Key::PageDown:
        table.moveCursor(table.page());
        return true;
    case Key::Home:
        table.moveCursorTo(0);
        return true;
    case Key::End:
        table.moveToEnd();
        return true;
    default:
        return false;
    }
}

void FrontEnd::openOrScroll(TerminalTable& table, bool mayScroll) {
    if (mayScroll && table.scrollSideways(kScrollColumns)) {
        return;
    }
    if (const auto row = table.selectedRow()) {
        table.source().didSelectRow(row);
    }
}

void FrontEnd::goBack(TerminalTable& table) {
    if (!table.scrollSideways(-kScrollColumns)) {
        navigation()->back();
    }
}

void FrontEnd::escape(TerminalTable& table) {
    if (table.filter().empty()) {
        navigation()->back();
    } else {
        table.setFilter("");
    }
}

} // namespace pallax::terminal
