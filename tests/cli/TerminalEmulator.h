#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace pallax::doubles {

/// What a terminal of type xterm shows after the bytes that were written to it: enough of one for
/// what the curses library writes. Control sequences it does not know are counted, not guessed.
class TerminalEmulator {
public:
    TerminalEmulator(int columns, int rows);

    void write(std::string_view bytes);
    /// The rows without the blanks at their ends, each with its line end.
    std::string text() const;
    bool isOnOtherScreen() const { return _isOnOtherScreen; }
    /// Final bytes of control sequences that were not understood.
    const std::string& unknown() const { return _unknown; }
    void resize(int columns, int rows);

private:
    using Row = std::vector<std::string>; // one text per column; empty right of a wide one

    void step(char byte);
    void control(char byte);
    void escape(char byte);
    void sequence(char final);
    // Each does what the final byte of a control sequence says; false when that is not its own.
    bool moveCursor(char final, int count);
    bool editRow(char final, int count);
    bool editScreen(char final, int count);
    void privateMode(bool isSet);
    void print(const std::string& character);
    void eraseInDisplay(int what);
    void eraseInLine(int what);
    void scrollUp(int count);
    void scrollDown(int count);
    void insertLines(int count);
    void deleteLines(int count);
    int number(std::size_t index, int otherwise) const;
    void clampCursor();
    Row blankRow() const { return Row(static_cast<std::size_t>(_columns), " "); }
    Row& row() { return _rows[static_cast<std::size_t>(_y)]; }

    enum class State { Text, Escape, Charset, Sequence, System };
    State _state = State::Text;
    int _columns;
    std::vector<Row> _rows;
    std::vector<Row> _mainScreen; // while the other one is shown
    bool _isOnOtherScreen = false;
    int _x = 0;
    int _y = 0;
    int _top = 0;
    int _bottom = 0; // the scroll region's last row
    bool _wrapsNext = false;
    std::string _character; // the UTF-8 bytes so far
    std::size_t _missing = 0;
    std::string _last; // what was printed last
    std::string _parameters;
    std::string _unknown;
};

} // namespace pallax::doubles
