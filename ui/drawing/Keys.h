#pragma once

namespace pallax::terminal {

enum class Key {
    Character,
    Enter,
    Escape,
    Backspace,
    Delete,
    Tab,
    BackTab,
    Up,
    Down,
    Left,
    Right,
    PageUp,
    PageDown,
    Home,
    End,
    Click,
    Drag,    ///< the mouse was moved while its button was held
    Release, ///< of the mouse button
    WheelUp,
    WheelDown,
};

/// A user event: a key or a mouse action.
struct KeyEvent {
    Key key = Key::Character;
    char32_t character = 0; ///< for Key::Character; below U+0020 with the control key
    int x = 0;              ///< the column of a mouse event
    int y = 0;              ///< its row
};

/// The key of a character.
constexpr KeyEvent typed(char32_t character) {
    return {.key = Key::Character, .character = character};
}

/// The character that a letter sends with the control key.
constexpr char32_t controlKey(char letter) {
    return static_cast<char32_t>(letter - 'a' + 1);
}

} // namespace pallax::terminal
