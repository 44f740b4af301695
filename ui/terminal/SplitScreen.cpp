#include "ui/terminal/SplitScreen.h"

#include "ui/drawing/TextWidth.h"
#include "ui/terminal/FrontEnd.h"

#include <algorithm>
#include <utility>

namespace pallax::terminal {

namespace {

constexpr int kListRow = 0;
constexpr int kListRows = 1;
constexpr int kLineColumns = 1; // between two sides
constexpr std::string_view kNextHint = "Ctrl-N next";

bool isMouse(const KeyEvent& event) {
    return event.key == Key::Click || event.key == Key::WheelUp || event.key == Key::WheelDown;
}

/// What follows a click that gave a side the keyboard.
bool isDrag(const KeyEvent& event) {
    return event.key == Key::Drag || event.key == Key::Release;
}

KeyEvent inside(KeyEvent event, int left) {
    event.x -= left;
    event.y -= kListRows;
    return event;
}

} // namespace

SplitScreen::SplitScreen(std::vector<Modem> modems, const Marks& marks,
                         std::function<void()> needsDisplay)
    : _modems(std::move(modems)), _marks(marks), _needsDisplay(std::move(needsDisplay)) {}

void SplitScreen::resize(int columns, int rows) {
    _columns = std::max(columns, 0);
    _rows = std::max(rows, 0);
    layOut();
}

/// Invisible modems get the size that they will have when they are visible.
void SplitScreen::layOut() {
    if (_modems.size() == 1) {
        return current().resize(_columns, _rows);
    }
    const int fitting = (_columns + kLineColumns) / (kLeastColumns + kLineColumns);
    const int count = std::clamp(fitting, 1, static_cast<int>(_modems.size()));
    const auto visible = static_cast<std::size_t>(count);
    if (_current < _first) {
        _first = _current;
    } else if (_current >= _first + visible) {
        _first = _current + 1 - visible;
    }
    _first = std::min(_first, _modems.size() - visible);
    const int room = _columns - (count - 1) * kLineColumns;
    const int rows = std::max(_rows - kListRows, 0);
    for (const Modem& modem : _modems) {
        modem.frontEnd.resize(room / count, rows);
    }
    _sides.clear();
    int left = 0;
    for (int side = 0; side < count; ++side) {
        const int end = (side + 1) * room / count + side * kLineColumns;
        const std::size_t modem = _first + static_cast<std::size_t>(side);
        _sides.push_back({modem, left, end - left});
        _modems[modem].frontEnd.resize(end - left, rows);
        left = end + kLineColumns;
    }
    _needsDisplay();
}

Grid SplitScreen::draw() {
    if (_modems.size() == 1) {
        return current().draw();
    }
    Grid grid(_columns, _rows);
    drawSides(grid);
    drawList(grid);
    return grid;
}

void SplitScreen::drawSides(Grid& grid) {
    for (const Side& side : _sides) {
        const Grid drawn = _modems[side.modem].frontEnd.draw();
        grid.paste(drawn, side.left, kListRows);
        if (side.modem == _current && drawn.cursor()) {
            grid.setCursor({side.left + drawn.cursor()->x, kListRows + drawn.cursor()->y});
        }
        for (int y = kListRows; side.left > 0 && y < _rows; ++y) {
            grid.put(side.left - kLineColumns, y, _marks.vertical, {.dim = true});
        }
    }
}

std::string SplitScreen::label(std::size_t modem, bool withName) const {
    std::string text = std::to_string(modem + 1);
    if (withName) {
        text += ' ' + _modems[modem].name;
    }
    text += _modems[modem].frontEnd.hasAlarms() ? " !" : "";
    return modem == _current ? '[' + text + ']' : ' ' + text + ' ';
}

bool SplitScreen::namesFit() const {
    int columns = 0;
    for (std::size_t modem = 0; modem < _modems.size(); ++modem) {
        columns += columnsOf(label(modem, true));
    }
    return columns <= _columns;
}

/// Where there is no room for all names, only the modem with the keyboard has one. Where all modems
/// are visible, each name is above its side.
void SplitScreen::drawList(Grid& grid) {
    _hits.clear();
    const bool withNames = namesFit();
    int x = 0;
    for (std::size_t modem = 0; modem < _modems.size(); ++modem) {
        const bool isCurrent = modem == _current;
        if (_sides.size() == _modems.size()) {
            x = std::max(x, _sides[modem].left);
        }
        const std::string text = label(modem, withNames || isCurrent);
        const int end = grid.put(x, kListRow, text, {.bold = isCurrent, .accent = isCurrent});
        _hits.add(x, kListRow, end - x, kListRows, [this, modem] { choose(modem + 1); });
        x = end;
    }
    const int left = _columns - columnsOf(kNextHint) - kMargin;
    if (left >= x + kGap) {
        grid.put(left, kListRow, kNextHint, {.dim = true});
        _hits.add(left, kListRow, columnsOf(kNextHint), kListRows,
                  [this] { handle(typed(controlKey('n'))); });
    }
}

void SplitScreen::choose(std::size_t number) {
    if (number >= 1 && number <= _modems.size() && _modems.size() > 1) {
        _current = number - 1;
        layOut();
    }
}

void SplitScreen::handle(const KeyEvent& event) {
    const bool isSplit = _modems.size() > 1;
    const bool isNext = event.key == Key::Character && event.character == controlKey('n');
    if (isSplit && isNext) {
        choose((_current + 1) % _modems.size() + 1);
    } else if (isSplit && isMouse(event)) {
        handleMouse(event);
    } else if (isSplit && isDrag(event)) {
        const auto side = std::find_if(_sides.begin(), _sides.end(),
                                       [this](const Side& each) { return each.modem == _current; });
        current().handle(inside(event, side->left));
    } else {
        current().handle(event);
    }
}

/// The wheel scrolls what is under it and leaves the keyboard where it is.
void SplitScreen::handleMouse(const KeyEvent& event) {
    if (event.y < kListRows) {
        // A copy, because the list is drawn again.
        const HitMap::Action action =
            event.key == Key::Click ? _hits.at(event.x, event.y) : HitMap::Action();
        return action ? action() : void();
    }
    for (const Side& side : std::vector<Side>(_sides)) {
        if (event.x >= side.left && event.x < side.left + side.columns) {
            _modems[side.modem].frontEnd.handle(inside(event, side.left));
            if (event.key == Key::Click) {
                choose(side.modem + 1); // last, because it makes click areas out of date
            }
        }
    }
}

bool SplitScreen::isAnimated() const {
    return std::any_of(_modems.begin(), _modems.end(),
                       [](const Modem& modem) { return modem.frontEnd.isAnimated(); });
}

void SplitScreen::turn() {
    for (const Modem& modem : _modems) {
        if (modem.frontEnd.isAnimated()) {
            modem.frontEnd.turn();
        }
    }
}

} // namespace pallax::terminal
