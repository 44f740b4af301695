#include "console/TerminalLine.h"

#include "text/Printable.h"

#include <algorithm>
#include <cstdio>
#include <sys/ioctl.h>
#include <unistd.h>

namespace pallax {

TerminalLine TerminalLine::onStandardError() {
    constexpr std::size_t kUsualColumns = 80; // for a terminal of unknown width
    winsize size{};
    const bool isTerminal = ::isatty(STDERR_FILENO) != 0;
    const bool isTold = ::ioctl(STDERR_FILENO, TIOCGWINSZ, &size) == 0 && size.ws_col > 0;
    const std::size_t columns = isTold ? size.ws_col : kUsualColumns;
    return {isTerminal ? columns : 0, [](std::string_view bytes) {
                (void)std::fwrite(bytes.data(), 1, bytes.size(), stderr);
                (void)std::fflush(stderr);
            }};
}

void TerminalLine::show(std::string_view text) {
    if (!isPossible()) {
        return;
    }
    std::string bytes = "\r";
    appendPrintable(bytes, text);
    bytes.resize(std::min(bytes.size(), _columns)); // including the return, less the last column,
                                                    // which may wrap
    const std::size_t fitting = bytes.size() - 1;
    bytes.append(_shown - std::min(_shown, fitting), ' ');
    _shown = fitting;
    _write(bytes);
}

void TerminalLine::wipe() {
    if (_shown > 0) {
        show({});
        _write("\r");
    }
}

void TerminalLine::leave() {
    if (_shown > 0) {
        _write("\n");
        _shown = 0;
    }
}

} // namespace pallax
