#pragma once

#include <cstddef>
#include <functional>
#include <string>
#include <string_view>

namespace pallax {

/// One line of a terminal that is rewritten in place, without control sequences.
class TerminalLine {
public:
    using Write = std::function<void(std::string_view bytes)>;

    /// For a terminal of `columns` columns; 0 means no terminal, and nothing is written.
    TerminalLine(std::size_t columns, Write write) : _columns(columns), _write(std::move(write)) {}
    /// On standard error, if that is a terminal.
    static TerminalLine onStandardError();

    bool isPossible() const { return _columns > 0; }
    /// Replaces the line; text that does not fit is cut.
    void show(std::string_view text);
    /// Clears the line.
    void wipe();
    /// Keeps the line; further output starts below it.
    void leave();

private:
    std::size_t _columns;
    Write _write;
    std::size_t _shown = 0; // columns in use
};

} // namespace pallax
