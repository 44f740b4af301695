#pragma once

#include "ui/terminal/Keys.h"

#include <optional>

namespace pallax::terminal {

/// A key code of the curses library; nothing for one without a meaning here. Mouse events are
/// taken from the library's queue.
std::optional<KeyEvent> keyOfCode(unsigned code);

/// A character that was typed; what stands for a key becomes that key.
KeyEvent keyOfCharacter(char32_t character);

} // namespace pallax::terminal
