#include "tests/cli/TerminalEmulator.h"

#include "ui/terminal/TextWidth.h"

#include <algorithm>
#include <cstdlib>
#include <utility>

namespace pallax::doubles {

namespace {

constexpr char kEscape = '\x1B';
constexpr char kBell = '\a';

std::size_t sequenceLength(unsigned char first) {
    return first >= 0xF0 ? 4 : first >= 0xE0 ? 3 : first >= 0xC0 ? 2 : 1;
}

} // namespace

TerminalEmulator::TerminalEmulator(int columns, int rows)
    : _columns(columns), _rows(static_cast<std::size_t>(rows), blankRow()), _bottom(rows - 1) {}

void TerminalEmulator::resize(int columns, int rows) {
    _columns = columns;
    for (Row& row : _rows) {
        row.resize(static_cast<std::size_t>(columns), " ");
    }
    _rows.resize(static_cast<std::size_t>(rows), blankRow());
    _top = 0;
    _bottom = rows - 1;
    clampCursor();
}

void TerminalEmulator::write(std::string_view bytes) {
    for (const char byte : bytes) {
        step(byte);
    }
}

std::string TerminalEmulator::text() const {
    std::string text;
    for (const Row& row : _rows) {
        std::string line;
        for (const std::string& cell : row) {
            line += cell;
        }
        line.erase(line.find_last_not_of(' ') + 1);
        text += line + "\n";
    }
    return text;
}

void TerminalEmulator::step(char byte) {
    switch (_state) {
    case State::Text:
        return control(byte);
    case State::Escape:
        return escape(byte);
    case State::Charset:
        _state = State::Text;
        return;
    case State::Sequence:
        if (byte >= '@' && byte <= '~') {
            _state = State::Text;
            return sequence(byte);
        }
        _parameters += byte;
        return;
    case State::System:
        if (byte == kBell) {
            _state = State::Text;
        } else if (byte == kEscape) {
            _state = State::Charset; // takes the backslash
        }
        return;
    }
}

void TerminalEmulator::control(char byte) {
    if (_missing > 0) {
        _character += byte;
        if (--_missing == 0) {
            print(std::exchange(_character, ""));
        }
        return;
    }
    switch (byte) {
    case kEscape:
        _state = State::Escape;
        return;
    case '\r':
        _x = 0;
        _wrapsNext = false;
        return;
    case '\n':
        _y == _bottom ? scrollUp(1) : static_cast<void>(_y++);
        clampCursor();
        return;
    case '\b':
        _x = std::max(_x - 1, 0);
        _wrapsNext = false;
        return;
    case '\t':
        _x = std::min((_x / 8 + 1) * 8, _columns - 1);
        return;
    default:
        break;
    }
    if (static_cast<unsigned char>(byte) < 0x20) {
        return;
    }
    _character = byte;
    _missing = sequenceLength(static_cast<unsigned char>(byte)) - 1;
    if (_missing == 0) {
        print(std::exchange(_character, ""));
    }
}

void TerminalEmulator::escape(char byte) {
    _state = State::Text;
    switch (byte) {
    case '[':
        _parameters.clear();
        _state = State::Sequence;
        return;
    case ']':
        _state = State::System;
        return;
    case '(':
    case ')':
        _state = State::Charset;
        return;
    case 'M':
        _y == _top ? scrollDown(1) : static_cast<void>(_y--);
        return;
    case '=':
    case '>':
    case '7':
    case '8':
        return;
    default:
        _unknown += byte;
    }
}

int TerminalEmulator::number(std::size_t index, int otherwise) const {
    std::size_t start = 0;
    for (; index > 0; --index) {
        start = _parameters.find(';', start);
        if (start == std::string::npos) {
            return otherwise;
        }
        ++start;
    }
    const int value = std::atoi(_parameters.c_str() + start); // NOLINT(cert-err34-c)
    return value == 0 ? otherwise : value;
}

void TerminalEmulator::sequence(char final) {
    if (!_parameters.empty() && _parameters.front() == '?') {
        if (final == 'h' || final == 'l') {
            privateMode(final == 'h');
        }
        return;
    }
    const int count = number(0, 1);
    const bool keepsWrap = final == 'm' || final == 'b';
    _wrapsNext = _wrapsNext && keepsWrap;
    constexpr std::string_view kWithoutEffect = "mtlh"; // colours and modes that no text shows
    if (final == 'b') {
        for (int repeated = 0; repeated < count; ++repeated) {
            print(_last);
        }
    } else if (!moveCursor(final, count) && !editRow(final, count) && !editScreen(final, count) &&
               kWithoutEffect.find(final) == std::string_view::npos) {
        _unknown += final;
    }
    clampCursor();
}

bool TerminalEmulator::moveCursor(char final, int count) {
    switch (final) {
    case 'H':
    case 'f':
        _y = number(0, 1) - 1;
        _x = number(1, 1) - 1;
        return true;
    case 'A':
        _y -= count;
        return true;
    case 'B':
        _y += count;
        return true;
    case 'C':
        _x += count;
        return true;
    case 'D':
        _x -= count;
        return true;
    case 'G':
        _x = count - 1;
        return true;
    case 'd':
        _y = count - 1;
        return true;
    default:
        return false;
    }
}

bool TerminalEmulator::editRow(char final, int count) {
    Row& line = row();
    const auto at = line.begin() + _x;
    const int changed = std::min(count, _columns - _x);
    switch (final) {
    case 'K':
        eraseInLine(number(0, 0));
        return true;
    case 'X':
        std::fill_n(at, changed, " ");
        return true;
    case 'P':
        std::rotate(at, at + changed, line.end());
        std::fill_n(line.rbegin(), changed, " ");
        return true;
    case '@':
        std::rotate(at, line.end() - changed, line.end());
        std::fill_n(at, changed, " ");
        return true;
    default:
        return false;
    }
}

bool TerminalEmulator::editScreen(char final, int count) {
    switch (final) {
    case 'J':
        eraseInDisplay(number(0, 0));
        return true;
    case 'L':
        insertLines(count);
        return true;
    case 'M':
        deleteLines(count);
        return true;
    case 'S':
        scrollUp(count);
        return true;
    case 'T':
        scrollDown(count);
        return true;
    case 'r':
        _top = number(0, 1) - 1;
        _bottom = number(1, static_cast<int>(_rows.size())) - 1;
        _x = _y = 0;
        return true;
    default:
        return false;
    }
}

void TerminalEmulator::privateMode(bool isSet) {
    if (_parameters != "?1049" || isSet == _isOnOtherScreen) {
        return;
    }
    _isOnOtherScreen = isSet;
    if (isSet) {
        _mainScreen = _rows;
        std::fill(_rows.begin(), _rows.end(), blankRow());
    } else {
        _rows.swap(_mainScreen);
        resize(_columns, static_cast<int>(_mainScreen.size()));
    }
}

void TerminalEmulator::print(const std::string& character) {
    const int width = terminal::columnsOf(character);
    if (_wrapsNext) {
        _wrapsNext = false;
        _x = 0;
        _y == _bottom ? scrollUp(1) : static_cast<void>(_y++);
        clampCursor();
    }
    _last = character;
    if (width == 0 || _x + width > _columns) {
        return;
    }
    row()[static_cast<std::size_t>(_x)] = character;
    if (width == 2) {
        row()[static_cast<std::size_t>(_x + 1)] = "";
    }
    _x += width;
    if (_x == _columns) {
        _x = _columns - 1;
        _wrapsNext = true;
    }
}

void TerminalEmulator::eraseInDisplay(int what) {
    eraseInLine(what);
    for (int y = 0; y < static_cast<int>(_rows.size()); ++y) {
        if ((what == 0 && y > _y) || (what == 1 && y < _y) || what == 2) {
            _rows[static_cast<std::size_t>(y)] = blankRow();
        }
    }
}

void TerminalEmulator::eraseInLine(int what) {
    const auto from = row().begin() + (what == 0 ? _x : 0);
    const auto to = what == 1 ? row().begin() + _x + 1 : row().end();
    std::fill(from, to, " ");
}

void TerminalEmulator::scrollUp(int count) {
    const int y = std::exchange(_y, _top);
    deleteLines(count);
    _y = y;
}

void TerminalEmulator::scrollDown(int count) {
    const int y = std::exchange(_y, _top);
    insertLines(count);
    _y = y;
}

void TerminalEmulator::insertLines(int count) {
    for (; count > 0 && _y <= _bottom; --count) {
        _rows.erase(_rows.begin() + _bottom);
        _rows.insert(_rows.begin() + _y, blankRow());
    }
}

void TerminalEmulator::deleteLines(int count) {
    for (; count > 0 && _y <= _bottom; --count) {
        _rows.erase(_rows.begin() + _y);
        _rows.insert(_rows.begin() + _bottom, blankRow());
    }
}

void TerminalEmulator::clampCursor() {
    _x = std::clamp(_x, 0, _columns - 1);
    _y = std::clamp(_y, 0, static_cast<int>(_rows.size()) - 1);
    _bottom = std::clamp(_bottom, 0, static_cast<int>(_rows.size()) - 1);
    _top = std::clamp(_top, 0, _bottom);
}

} // namespace pallax::doubles
