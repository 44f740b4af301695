#pragma once

#include <string>

namespace pallax::terminal {

/// A string capability of the terminal type in use, by its short terminfo name; empty where it
/// has none. `name` must be that of a string capability. (In a file of its own, for the library's
/// header defines such names as "columns".)
std::string terminalCapability(const char* name);

} // namespace pallax::terminal
