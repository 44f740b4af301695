#include "ui/terminal/FrontEnd.h"

#include "ui/contents/TravelWords.h"
#include "ui/pages/EventText.h"
#include "ui/pages/Overlays.h"
#include "ui/terminal/ModalKeys.h"
#include "ui/terminal/PaneView.h"

#include <algorithm>
#include <utility>

namespace pallax::terminal {

FrontEnd::FrontEnd(Surroundings surroundings, const Marks& marks)
    : _surroundings(std::move(surroundings)), _marks(marks), _toolkit([this] { needsDisplay(); }),
      _modalKeys([this] { needsDisplay(); },
                 [this] {
                     _help.open(HelpPlace::Save);
                     needsDisplay();
                 }),
      _time({_surroundings.travel, _toolkit,
             [this](std::string text) { setMessage(std::move(text)); },
             [this] { needsDisplay(); }}),
      _shown(_surroundings.valueSource()), _finder(finderSurroundings()),
      _hitWalk(hitWalkSurroundings()) {
    _toolkit.lists().partAt = _surroundings.entryPart;
    _toolkit.lists().ageAt = [this](const std::string& path) {
        _shown.update();
        return _shown.ageAt(path);
    };
}

/// Click areas may be out of date until the next drawing.
void FrontEnd::needsDisplay() {
    _hits.clear();
    _surroundings.needsDisplay();
}

TerminalNavigation* FrontEnd::navigation() const {
    TerminalNavigation* live = _toolkit.navigation();
    TerminalNavigation* held = live == nullptr ? nullptr : _time.panes(*live);
    return held != nullptr ? held : live;
}

TerminalTable* FrontEnd::table() const {
    TerminalNavigation* panes = navigation();
    return panes == nullptr ? nullptr : &terminalTable(panes->top().table());
}

Grid FrontEnd::draw() {
    Grid grid(_toolkit.columns(), _toolkit.rows());
    _hits.clear();
    TerminalNavigation* panes = navigation();
    if (panes == nullptr) {
        return grid;
    }
    if (grid.columns() < kLeastColumns || grid.rows() < kLeastRows) {
        drawTooSmall(grid);
        return grid;
    }
    endFilterOfOtherPane();
    drawScreen(grid, *panes);
    if (const auto& modal = _toolkit.navigation()->modal()) {
        ModalView(grid, _marks, _hits).draw(*modal, _modalKeys.focus());
    }
    if (_help.isOpen()) {
        _help.draw(grid, _marks);
    }
    if (const ui::Alert* alert = _toolkit.alert()) {
        drawAlert(grid, _marks, *alert);
    }
    return grid;
}

/// The topmost pane, or the page over it.
void FrontEnd::drawScreen(Grid& grid, TerminalNavigation& navigation) {
    const PaneStatus status{.spinnerTurn = _spinnerTurn,
                            .prompt = _filterEditor ? Prompt{"/", &*_filterEditor, kClearFilter}
                                                    : _time.prompt(),
                            .timeBar = _time.bar(),
                            .message = _message,
                            .note = _note,
                            .origin = _origin,
                            .oldValues = _time.isAway() ? std::string() : _oldValues,
                            .stream = _stream,
                            .alarms = _alarms,
                            .isSafe = _isSafe,
                            .zone = _surroundings.zone(),
                            .press = [this](const KeyEvent& event) { handle(event); },
                            .standing = [this](const auto& path) { return standingOfRow(path); },
                            .curve = [this](const std::string& path,
                                            int columns) { return curveOfRow(path, columns); }};
    if (_pages.isOpen()) {
        _pages.draw({grid, _marks, _hits}, {navigation.screens().front()->title(),
                                            navigation.top().toolbarItems(), status});
    } else {
        PaneView(grid, _marks, _hits).draw(navigation, status);
    }
}

void FrontEnd::openOverview() {
    _pages.open(OverviewPage([this] { return overviewWithCurves(); }));
    needsDisplay();
}

Wording FrontEnd::wording() const {
    return [this](std::string words) { return eventWords(std::move(words), _marks); };
}

PageTable::Copy FrontEnd::copier() {
    return [this](const std::string& text) { copy(text); };
}

void FrontEnd::openEvents() {
    _pages.open(EventsPage(
        {{_surroundings.moment, _surroundings.ahead, wording()}, _surroundings.goTo, copier()}));
    needsDisplay();
}

void FrontEnd::openQuery() {
    _pages.open(QueryPage({_surroundings.moment, _surroundings.goTo, _surroundings.mayGoOn,
                           _surroundings.queries, _surroundings.ahead, wording()},
                          copier()));
    needsDisplay();
}

void FrontEnd::forgetTimeline() {
    _shown.forget();
    _finder.forget();
    _time.forget();
}

void FrontEnd::setSafe(bool isSafe) {
    _isSafe = isSafe;
    forgetTimeline();
    _pages = {};
    _graph = {};
    _hitWalk.forget();
    _filterEditor.reset();
    if (TerminalTable* const pane = table()) {
        pane->setFilter("");
    }
    needsDisplay();
}

void FrontEnd::setMessage(std::string message) {
    _message = std::move(message);
    needsDisplay();
}

void FrontEnd::setNote(std::string note) {
    _note = std::move(note);
    needsDisplay();
}

void FrontEnd::setOrigin(Origin origin) {
    _origin = std::move(origin);
    needsDisplay();
}

void FrontEnd::setStream(std::string state) {
    _stream = std::move(state);
    needsDisplay();
}

void FrontEnd::setAlarms(std::vector<std::string> names) {
    _alarms = std::move(names);
    needsDisplay();
}

void FrontEnd::setOldValues(std::string time) {
    _oldValues = std::move(time);
    needsDisplay();
}

bool FrontEnd::isAnimated() const {
    const TerminalNavigation* navigation = _toolkit.navigation();
    return _time.isPlaying() ||
           (navigation != nullptr && isLoading(navigation->top().toolbarItems()));
}

void FrontEnd::turn() {
    ++_spinnerTurn;
    if (_time.turn() || !_time.isPlaying()) {
        needsDisplay();
    }
}

void FrontEnd::handle(const KeyEvent& event) {
    TerminalNavigation* navigation = _toolkit.navigation();
    if (navigation == nullptr) {
        return;
    }
    if (event.key == Key::Drag) {
        return handleDrag(event);
    }
    _dragged.reset();
    if (event.key == Key::Release) {
        return;
    }
    if (event.key == Key::Character && event.character == controlKey('l')) {
        _surroundings.repaint();
        return;
    }
    if (_message) {
        _message.reset();
        _surroundings.needsDisplay(); // the click areas do not change
    }
    endFilterOfOtherPane();
    // A copy, because the action may close the screen.
    const std::shared_ptr<ui::ModalScreen> modal = navigation->modal();
    if (!modal) {
        _modalKeys.reset(); // for the next one to be opened
    }
    if (_toolkit.alert() != nullptr) {
        handleAlert(event);
    } else if (_help.isOpen()) {
        _help.handle(event);
        needsDisplay();
    } else if (_time.isTyping() && event.key != Key::Click) {
        (void)_time.handle(event);
    } else if (_pages.isOpen() && !modal && event.key != Key::Click) {
        handlePage(event);
    } else if (event.key == Key::Click || event.key == Key::WheelUp ||
               event.key == Key::WheelDown) {
        handleMouse(event);
    } else if (modal) {
        _modalKeys.handle(*modal, event);
    } else if (_filterEditor) {
        handleFilter(*table(), event);
    } else {
        handlePane(event);
    }
}

void FrontEnd::handleMouse(const KeyEvent& event) {
    constexpr std::ptrdiff_t kWheelRows = 3;
    if (event.key != Key::Click) {
        const std::ptrdiff_t rows = event.key == Key::WheelUp ? -kWheelRows : kWheelRows;
        if (const auto& modal = _toolkit.navigation()->modal()) {
            terminalTable(modal->list()).scroll(rows);
        } else {
            table()->moveCursor(rows);
        }
        return;
    }
    _dragged = _hits.sliderAt(event.x, event.y);
    // A copy, because the action may change the screen.
    if (const HitMap::Action action = _hits.at(event.x, event.y)) {
        action();
        needsDisplay();
    }
}

void FrontEnd::handleDrag(const KeyEvent& event) {
    if (_dragged) {
        _message.reset();
        _dragged->moveTo(event.x);
        needsDisplay();
    }
}

void FrontEnd::handleAlert(const KeyEvent& event) {
    const bool closes =
        event.key == Key::Enter || event.key == Key::Escape || event.key == Key::Click ||
        (event.key == Key::Character && (event.character == U' ' || event.character == U'q'));
    if (closes) {
        _toolkit.closeAlert();
    }
}

/// The keys that open pages, save, help and start afresh work as in a pane.
void FrontEnd::handlePage(const KeyEvent& event) {
    if (_pages.handle(event) != PageAnswer::NotMine) {
        if (_isPaneWanted) {
            _pages = {};
            _isPaneWanted = false;
        }
        return needsDisplay();
    }
    const char32_t character = event.key == Key::Character ? event.character : 0;
    if (handleTime(event) || handleNumber(character)) {
        return;
    }
    if (character == U'q') {
        _pages.closeTop();
        needsDisplay();
    } else if (character == U'x') {
        _surroundings.switchSafe();
    } else if (std::u32string_view(U"?RVoe;fs").find(character) != std::u32string_view::npos) {
        handlePaneCharacter(character);
    }
}

bool FrontEnd::handleTime(const KeyEvent& event) {
    if (event.key == Key::Character && event.character == U'd' && _surroundings.travel != nullptr) {
        openChanges();
        return true;
    }
    return findAgain(event) || _time.handle(event);
}

void FrontEnd::openChanges() {
    if (!_time.hasMark()) {
        return setMessage(kNothingMarked);
    }
    _pages.open(ChangesPage([this]() -> const ChangesContent& { return _time.changes(); }));
    needsDisplay();
}

void FrontEnd::handleFilter(TerminalTable& table, const KeyEvent& event) {
    const bool erasesNothing = event.key == Key::Backspace && _filterEditor->text().empty();
    if (event.key == Key::Escape || erasesNothing) {
        _filterEditor.reset();
        table.setFilter("");
    } else if (event.key == Key::Enter) {
        _filterEditor.reset();
        needsDisplay();
    } else if (event.key == Key::Up || event.key == Key::Down || event.key == Key::PageUp ||
               event.key == Key::PageDown) {
        (void)moveCursor(table, event);
    } else if (_filterEditor->handle(event)) {
        table.setFilter(_filterEditor->text());
    }
}

void FrontEnd::save() {
    const ui::SaveButton* button = saveButtonOf(_toolkit.navigation()->top().toolbarItems());
    if (button == nullptr) {
        return _toolkit.showAlert(
            {"Saving is not enabled here",
             "Two settings in pallax.conf enable it: snapshot-directory, where snapshots go, and "
             "save-button-marker, a path that exists.",
             "Close"});
    }
    const auto action = button->action; // a copy, because the items may be replaced
    action();
    if (_time.isAway()) {
        setMessage("The present is saved, not the instant that is shown.");
    }
}

void FrontEnd::copyValue(TerminalTable& table) {
    if (const auto copied = table.copied()) {
        copy(*copied);
    }
}

void FrontEnd::copy(const std::string& text) {
    _surroundings.copy(text);
    setMessage("Copied: " + text);
}

void FrontEnd::startFilter(TerminalTable& table) {
    LineEditor editor;
    editor.setText(table.filter());
    _filterEditor = std::move(editor);
    _filteredPane = navigation()->screens().back();
    needsDisplay();
}

void FrontEnd::endFilterOfOtherPane() {
    if (_filteredPane.lock() != navigation()->screens().back()) {
        _filterEditor.reset();
    }
}

} // namespace pallax::terminal
