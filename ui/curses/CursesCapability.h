#pragma once

#include <string>

namespace pallax::terminal {

/// A string capability of the terminal type, by its short terminfo name; empty if the type lacks
/// it. `name` must be the name of a string capability. (In its own file, because the library's
/// header defines names such as "columns".)
std::string terminalCapability(const char* name);

} // namespace pallax::terminal
