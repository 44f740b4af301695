#pragma once

#include "ui/terminal/Keys.h"

#include <optional>
#include <string_view>

namespace pallax::terminal {

/// A key code of the curses library; nothing for one without a meaning here. Mouse events are
/// taken from the library's queue.
std::optional<KeyEvent> keyOfCode(unsigned code);

/// A character that was typed; what stands for a key becomes that key.
KeyEvent keyOfCharacter(char32_t character);

/// The key of a control sequence that the terminal's description does not tell (terminals differ
/// from what they say they are): "[" or "O", what stands between, and the final character. Nothing
/// for one without a meaning here.
std::optional<KeyEvent> keyOfSequence(std::string_view parameters, char32_t final);

} // namespace pallax::terminal
