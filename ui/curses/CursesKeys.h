#pragma once

#include "ui/drawing/Keys.h"

#include <optional>
#include <string_view>

namespace pallax::terminal {

/// The event of a curses key code; nothing for an unused code.
std::optional<KeyEvent> keyOfCode(unsigned code);

/// The event of a typed character, some of which are keys.
KeyEvent keyOfCharacter(char32_t character);

/// The key of a control sequence that is missing in the terminal's description (terminals differ
/// from their descriptions): "[" or "O", the parameters, and the final character. Nothing for an
/// unused sequence.
std::optional<KeyEvent> keyOfSequence(std::string_view parameters, char32_t final);

} // namespace pallax::terminal
