#include "ui/terminal/CursesCapability.h"

#include "ui/terminal/Curses.h"

#include <term.h>

namespace pallax::terminal {

std::string terminalCapability(const char* name) {
    const char* text = ::tigetstr(name);
    return text == nullptr ? "" : text;
}

} // namespace pallax::terminal
