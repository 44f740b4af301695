#pragma once

#include <cstddef>
#include <functional>
#include <string>
#include <string_view>

namespace pallax {

/// One line of a terminal that is written again and again, in place, without control sequences.
class TerminalLine {
public:
    using Write = std::function<void(std::string_view bytes)>;

    /// A terminal that is `columns` wide; with 0, there is none, and nothing is written.
    TerminalLine(std::size_t columns, Write write) : _columns(columns), _write(std::move(write)) {}
    /// On standard error, where that is a terminal.
    static TerminalLine onStandardError();

    bool isPossible() const { return _columns > 0; }
    /// In place of what is shown; what does not fit is left out.
    void show(std::string_view text);
    /// Nothing of it stays.
    void wipe();
    /// What is shown stays, and what follows stands below it.
    void leave();

private:
    std::size_t _columns;
    Write _write;
    std::size_t _shown = 0; // columns
};

} // namespace pallax
