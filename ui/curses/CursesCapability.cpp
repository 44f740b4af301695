#include "ui/curses/CursesCapability.h"

#include "ui/curses/Curses.h"

#include <term.h>

namespace pallax::terminal {

std::string terminalCapability(const char* name) {
    const char* text = ::tigetstr(name);
    return text == nullptr ? "" : text;
}

} // namespace pallax::terminal
