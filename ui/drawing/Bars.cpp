#include "ui/drawing/Bars.h"

#include "ui/drawing/Prompt.h"
#include "ui/drawing/TextWidth.h"

#include <algorithm>
#include <cmath>
#include <set>

namespace pallax::terminal {

namespace {

constexpr Style kSecondary{.dim = true};

const ui::Label* labelOf(const ui::BarItems& items) {
    for (const ui::BarItem& item : items) {
        if (const auto* label = std::get_if<ui::Label>(&item)) {
            return label;
        }
    }
    return nullptr;
}

} // namespace

const ui::SaveButton* saveButtonOf(const ui::BarItems& items) {
    for (const ui::BarItem& item : items) {
        if (const auto* button = std::get_if<ui::SaveButton>(&item)) {
            return button;
        }
    }
    return nullptr;
}

bool isLoading(const ui::BarItems& items) {
    return std::any_of(items.begin(), items.end(), [](const ui::BarItem& item) {
        const auto* indicator = std::get_if<ui::ActivityIndicator>(&item);
        return indicator != nullptr && indicator->isSpinning;
    });
}

int Bars::drawOrigin(int right, int columns) {
    const int end = right;
    std::string time = _status.timeBar ? _status.timeBar->words : std::string();
    if (columnsOf(time) > columns) {
        time = time.substr(0, time.find(','));
    }
    const std::string safe = _status.isSafe ? "safe" : "";
    for (const std::string& notice :
         {safe, time, _status.stream, alarmText(_status.alarms, right / 2)}) {
        if (!notice.empty()) {
            const int left = std::max(right - columnsOf(notice), kMargin);
            _grid.put(left, kTitleRow, notice, {.bold = true}, {kMargin, right});
            right = left - kGap;
        }
    }
    columns -= end - right;
    const std::string text = originText(_status.origin, _marks, columns);
    if (text.empty()) {
        return right;
    }
    const int left = right - columnsOf(text);
    _grid.put(left, kTitleRow, text, kSecondary);
    if (!_status.prompt) { // else the key would be typed
        _hits.add(left, kTitleRow, columnsOf(text), 1,
                  [press = _status.press] { press(typed(U'o')); });
    }
    return left - kGap;
}

int Bars::drawRule(int y, std::string_view mark, std::size_t hiddenRows, Key key) {
    _grid.fill({kMargin, _grid.columns() - kMargin}, y, _marks.horizontal, kSecondary);
    if (hiddenRows == 0) {
        return _grid.columns() - kMargin;
    }
    const int right = _grid.columns() - kMargin - 1;
    std::string text = " ";
    text.append(mark).append(1, ' ').append(std::to_string(hiddenRows)).append(1, ' ');
    const int left = right - columnsOf(text);
    _grid.put(left, y, text);
    _hits.add(left, y, right - left, 1, [press = _status.press, key] { press({.key = key}); });
    return left;
}

/// A text that does not fit is cut at its beginning, because times and file names are at its end.
int Bars::drawCutInFront(int x, int y, std::string_view text) {
    const int right = _grid.columns() - kMargin;
    const int beyond = x + columnsOf(text) - right;
    if (beyond <= 0) {
        return _grid.put(x, y, text);
    }
    const int start = _grid.put(x, y, _marks.more, kSecondary);
    (void)_grid.put(x - beyond, y, text, {}, {start, right});
    return right;
}

int Bars::drawStatus(const ui::BarItems& items, int ruleRight) {
    const int y = _grid.rows() - 1;
    int x = kMargin;
    if (_status.message) {
        return drawCutInFront(x, y, *_status.message);
    }
    if (isLoading(items)) {
        x = _grid.put(x, y, _marks.spinner.at(_status.spinnerTurn % _marks.spinner.size())) + 1;
    }
    if (const ui::Label* label = labelOf(items)) {
        x = drawCutInFront(x, y, label->text);
        const bool hasTime = !isLoading(items) && !label->text.empty();
        if (hasTime && x + 1 + columnsOf(_status.zone) <= _grid.columns() - kMargin) {
            x = _status.zone.empty() ? x : _grid.put(x + 1, y, _status.zone, kSecondary);
        }
    }
    if (_status.note.empty()) {
        return x;
    }
    if (x + kGap + columnsOf(_status.note) <= _grid.columns() - kMargin) {
        return _grid.put(x + kGap, y, _status.note, kSecondary);
    }
    (void)_grid.put(kMargin, y - 1, _status.note + " ", {}, {kMargin, ruleRight}); // in the rule
    return x;
}

void Bars::drawLastRow(const ui::BarItems& items, int ruleRight, const std::vector<Hint>& hints) {
    if (_status.prompt) {
        return drawPrompt(_grid, *this, _status.prompt->mark, *_status.prompt->editor,
                          _status.prompt->hint);
    }
    if (!_status.timeBar || _status.message) {
        return drawHints(hints, drawStatus(items, ruleRight));
    }
    drawHints({{"[ ] event", typed(U']')},
               {": go to", typed(U':')},
               {", . step", typed(U'.')},
               {_status.timeBar->isPlaying ? "Space hold" : "Space play", typed(U' ')},
               {"$ present", typed(U'$')},
               {"? help", typed(U'?')}},
              drawTimeBar(*_status.timeBar));
}

/// Returns the column after the bar and its clock.
int Bars::drawTimeBar(const TimeBar& bar) {
    constexpr int kLeastLength = 8;
    constexpr int kShare = 4; // of the row, one part
    const int y = _grid.rows() - 1;
    const int length = std::max(_grid.columns() / kShare, kLeastLength);
    int x = _grid.put(kMargin, y, _marks.timeBegin, kSecondary);
    const int first = x;
    const auto columnOfPlace = [first, length](double place) {
        return first + static_cast<int>(std::lround(place * (length - 1)));
    };
    _grid.fill({first, first + length}, y, _marks.horizontal, kSecondary);
    std::set<int> events;
    for (const double event : bar.events) {
        events.insert(columnOfPlace(event));
    }
    if (static_cast<int>(events.size()) <= length / 2) { // more would tell nothing
        for (const int column : events) {
            _grid.put(column, y, _marks.timeEvent, kSecondary);
        }
    }
    if (bar.marked) {
        _grid.put(columnOfPlace(*bar.marked), y, _marks.timeMark, {.tint = Tint::Purple});
    }
    _grid.put(columnOfPlace(bar.shown), y, _marks.timeShown, {.accent = true});
    _hits.add(y, {first, length, bar.go});
    x = _grid.put(first + length, y, _marks.timeEnd, kSecondary);
    return _grid.put(x + 1, y, bar.clock);
}

void Bars::drawHint(int left, std::string_view text, const KeyEvent& key) {
    const int y = _grid.rows() - 1;
    const int end = _grid.put(left, y, text, kSecondary);
    _hits.add(left, y, end - left, 1, [press = _status.press, key] { press(key); });
}

void Bars::drawHints(const std::vector<Hint>& hints, int from) {
    int right = _grid.columns() - kMargin;
    for (auto hint = hints.rbegin(); hint != hints.rend(); ++hint) {
        const int left = right - columnsOf(hint->text);
        if (left < from + kGap) {
            break;
        }
        drawHint(left, hint->text, hint->key);
        right = left - kGap;
    }
    const bool isLastLeftOut = right == _grid.columns() - kMargin;
    if (isLastLeftOut && right - 1 > from) {
        drawHint(right - 1, hints.back().text.substr(0, 1), hints.back().key);
    }
}

} // namespace pallax::terminal
